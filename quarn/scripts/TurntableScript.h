#pragma once

#include "quarn/scripts/RecordingScript.h"

#include <optional>

namespace quarn::program {

/// A turntable that is to be recorded.
struct TurntableRequest {
    RecordingRequest recording;
    std::string direction;      ///< that the model seems to turn in: "clockwise", "anticlockwise"
    double elevation_deg = 0.0; ///< of the camera above the horizon through its target
    /// Where the camera of frame 0 stands, anticlockwise from the X axis as seen from above;
    /// nothing: in front of the model and to its right, as near as the first step of the turn takes
    /// it.
    std::optional<double> start_angle_deg;
    std::optional<double> lens_mm; ///< nothing: as the view has it
    std::optional<double> distance_factor;
    std::optional<Triple> target;
};

/// The host commands that frame the model and set a turntable up.
AnimationLines turntableLines(const TurntableRequest& request);

} // namespace quarn::program
