#include "quarn/scripts/TurntableScript.h"

#include "quarn/scripts/CameraToFit.h"

namespace quarn::program {

namespace {

/// In front of the model and to its right: shows two sides of a building, one of them more.
constexpr double AZIMUTH_DEG = -60.0;

std::string camera(const TurntableRequest& request) {
    return cameraToBeFitted(request.target.value_or(Triple{}), AZIMUTH_DEG, request.elevation_deg);
}

std::string fitView(const TurntableRequest& request) {
    std::string line = "_-FitView _Turn=Yes";
    if (request.target)
        line += " _KeepTarget=Yes";
    if (request.distance_factor)
        line += " _Distance " + numberText(*request.distance_factor);
    return line + " _Enter";
}

} // namespace

AnimationLines turntableLines(const TurntableRequest& request) {
    const std::string answers =
        std::to_string(request.recording.frames) +
        (request.direction == "clockwise" ? " _Clockwise " : " _AntiClockwise ") +
        sharedAnswers(request.recording);
    return {{camera(request), fitView(request)}, "_-SetTurntableAnimation " + answers};
}

} // namespace quarn::program
