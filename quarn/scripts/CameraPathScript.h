#pragma once

#include "quarn/scripts/RecordingScript.h"

#include <optional>

namespace quarn::program {

/// What a camera, or its target, follows. Exactly one of the three is there.
struct Followed {
    std::string object;               ///< name or id of a curve or a point; UTF-8
    std::filesystem::path curve_file; ///< a file that holds a curve
    std::optional<Triple> point;      ///< a place where it stays
};

/// A camera that follows something.
struct CameraPathRequest {
    RecordingRequest recording;
    Followed camera;
    std::optional<Followed> target; ///< nothing: the camera looks ahead along its own curve
    bool has_even_speed = false;    ///< of the camera, which follows a curve then
    std::optional<double> lens_mm;  ///< nothing: as it is in the document
};

/// The host commands that make what is followed where it comes from a file or the command line,
/// choose the lens, and set the animation up.
AnimationLines cameraPathLines(const CameraPathRequest& request);

} // namespace quarn::program
