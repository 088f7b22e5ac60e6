#pragma once

#include "quarn/runs/Recording.h"

#include <optional>

namespace quarn::program {

/// A camera that is to be written for other programs.
struct CameraExportRequest {
    std::filesystem::path document;
    std::optional<int> frame_rate; ///< nothing: as a film of the animation is played
    std::filesystem::path file;
};

/// `quarn camera`: composes a script that writes the camera of each frame of a document's
/// animation, and runs it or returns it.
Outcome exportCamera(const CameraExportRequest& request, const ScriptUse& use);

} // namespace quarn::program
