#pragma once

#include "quarn/runs/Recording.h"

#include <optional>

namespace quarn::program {

/// A frame that is to be written.
struct FrameRequest {
    std::filesystem::path document;
    int number = 0;                ///< from 0
    std::optional<PixelSize> size; ///< nothing: the view's
    LightRequest light;
    std::filesystem::path file;
};

/// `quarn frame`: composes a script that writes one frame of a document's animation, and runs it
/// or returns it.
Outcome writeSingleFrame(const FrameRequest& request, const ScriptUse& use);

} // namespace quarn::program
