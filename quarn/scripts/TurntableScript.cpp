#include "quarn/scripts/TurntableScript.h"

#include "quarn/scripts/CameraToFit.h"

#include <cmath>
#include <numbers>

namespace quarn::program {

namespace {

/// In front of the model and to its right: shows two sides of a building, one of them more.
constexpr double FIRST_AZIMUTH_DEG = -60.0;

/// How far round frame 0 is from where the camera stands when the turn is set up, which is the
/// place of the last frame. The set-up command divides its circle by the circle's parameter: each
/// quarter is a rational Bezier arc of degree 2 whose middle weight is the cosine of 45 degrees.
double firstStep_deg(int frames) {
    if (frames == 1)
        return 0.0;
    const double quarters = 4.0 / frames;
    const double whole = std::floor(quarters);
    const double t = quarters - whole;
    const double middle = std::numbers::sqrt2 * t * (1.0 - t);
    const double angle = std::atan2(middle + t * t, middle + (1.0 - t) * (1.0 - t));
    return 90.0 * whole + angle * 180.0 / std::numbers::pi;
}

/// The camera goes round the other way than the model seems to turn.
double azimuthAtSetUp_deg(const TurntableRequest& request) {
    if (!request.start_angle_deg)
        return FIRST_AZIMUTH_DEG;
    const double step = firstStep_deg(request.recording.frames);
    return *request.start_angle_deg - (request.direction == "clockwise" ? step : -step);
}

std::string camera(const TurntableRequest& request) {
    return cameraToBeFitted(request.target.value_or(Triple{}), azimuthAtSetUp_deg(request),
                            request.elevation_deg, request.lens_mm);
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
    return {{camera(request), fitView(request)}, {"_-SetTurntableAnimation " + answers}};
}

} // namespace quarn::program
