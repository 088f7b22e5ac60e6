#include "quarn/scripts/TurntableRequest.h"

#include "quarn/scripts/CameraToFit.h"

#include <cmath>

namespace quarn::program {

namespace {

constexpr double STEEPEST_ELEVATION_DEG = 89.0;

bool isClockwise(const std::string& typed, FirstMistake& mistake) {
    const std::string direction = lowerCase(typed);
    if (direction != "clockwise" && direction != "anticlockwise")
        mistake.note("--direction must be clockwise or anticlockwise" + notBut(typed));
    return direction == "clockwise";
}

double checkElevation(const std::string& typed, FirstMistake& mistake) {
    const std::optional<double> elevation = realNumber(typed);
    if (!elevation || std::abs(*elevation) > STEEPEST_ELEVATION_DEG)
        mistake.note("--elevation must be a number of degrees from -89 to 89" + notBut(typed));
    return elevation.value_or(0.0);
}

std::optional<double> checkDistance(const std::string& typed, FirstMistake& mistake) {
    const std::optional<double> factor = distanceFactor(typed);
    if (!typed.empty() && !factor)
        mistake.note("--distance must be a number from 0.01 to 1000" + notBut(typed));
    return factor;
}

std::optional<Triple> checkTarget(const std::string& typed, FirstMistake& mistake) {
    const std::optional<Triple> target = triple(typed);
    if (!typed.empty() && !target)
        mistake.note("--target must be three numbers X,Y,Z without blanks" + notBut(typed));
    return target;
}

} // namespace

std::variant<TurntableRequest, Outcome> checkTurntable(const TurntableOptions& options) {
    FirstMistake mistake;
    TurntableRequest request{};
    request.recording = checkRecording(options.recording, mistake);
    request.recording.frames = checkFrames(options.frames, mistake);
    request.is_clockwise = isClockwise(options.direction, mistake);
    request.elevation_deg = checkElevation(options.elevation_deg, mistake);
    request.distance_factor = checkDistance(options.distance_factor, mistake);
    request.target = checkTarget(options.target, mistake);
    if (mistake.text())
        return Outcome::misuse(*mistake.text());
    return request;
}

} // namespace quarn::program
