#include "quarn/TurntableScript.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn::program {

namespace {

/// In front of the model and to its right: shows two sides of a building, one of them more.
constexpr double AZIMUTH_DEG = -60.0;

constexpr double radians(double degrees) {
    return degrees * std::numbers::pi / 180.0;
}

/// Where the camera stands when the model is asked to be fitted into the view. The fit keeps the
/// direction alone; the distance grows with the coordinates so that no digit of it is lost.
Triple cameraLocation(const Triple& target, double elevation_deg) {
    const double distance =
        std::max({1.0, std::abs(target[0]), std::abs(target[1]), std::abs(target[2])});
    const double elevation = radians(elevation_deg);
    const double level = distance * std::cos(elevation);
    return {target[0] + level * std::cos(radians(AZIMUTH_DEG)),
            target[1] + level * std::sin(radians(AZIMUTH_DEG)),
            target[2] + distance * std::sin(elevation)};
}

std::string camera(const TurntableRequest& request) {
    const Triple target = request.target.value_or(Triple{0.0, 0.0, 0.0});
    return "_-Camera _Location " + tripleText(cameraLocation(target, request.elevation_deg)) +
           " _Target " + tripleText(target) + " _Enter";
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
    const std::string answers = std::to_string(request.recording.frames) +
                                (request.is_clockwise ? " _Clockwise " : " _AntiClockwise ") +
                                sharedAnswers(request.recording);
    return {{camera(request), fitView(request)}, "_-SetTurntableAnimation " + answers};
}

} // namespace quarn::program
