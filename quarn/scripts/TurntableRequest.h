#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/scripts/RecordingRequest.h"

#include <optional>
#include <variant>

namespace quarn::program {

/// A turntable that can be recorded: every value is checked.
struct TurntableRequest {
    RecordingRequest recording;
    bool is_clockwise;
    double elevation_deg; ///< of the camera above the horizon through its target
    std::optional<double> distance_factor;
    std::optional<Triple> target;
};

/// Checks what was typed, before anything runs.
/// @return the turntable, or the first mistake
std::variant<TurntableRequest, Outcome> checkTurntable(const TurntableOptions& options);

} // namespace quarn::program
