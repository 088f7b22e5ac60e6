#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/scripts/RecordingRequest.h"

#include <optional>
#include <variant>

namespace quarn::program {

/// What a camera, or its target, follows. Exactly one of the three is there.
struct Followed {
    std::string object;               ///< name or id of a curve or a point; UTF-8
    std::filesystem::path curve_file; ///< a file that holds a curve
    std::optional<Triple> point;      ///< a place where it stays
};

/// A camera that follows something: every value is checked.
struct CameraPathRequest {
    RecordingRequest recording;
    Followed camera;
    std::optional<Followed> target; ///< nothing: the camera looks ahead along its own curve
    bool has_even_speed;            ///< of the camera, which follows a curve then
    std::optional<double> lens_mm;  ///< nothing: as it is in the document
};

/// Checks what was typed, before anything runs.
/// @return what to record, or the first mistake
std::variant<CameraPathRequest, Outcome> checkFlythrough(const FlythroughOptions& options);
std::variant<CameraPathRequest, Outcome> checkPath(const PathOptions& options);

} // namespace quarn::program
