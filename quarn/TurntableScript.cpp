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

std::string setTurntable(const TurntableRequest& request) {
    return "_-SetTurntableAnimation " + std::to_string(request.frames) +
           (request.is_clockwise ? " _Clockwise" : " _AntiClockwise") + " _" + request.format +
           " " + request.capture_option + " _Enter _Enter";
}

} // namespace

TurntableScript composeTurntable(const TurntableRequest& request) {
    TurntableScript script;
    script.set_up = {readingLine(request.model, request.up_axis)};
    for (const std::string& name : request.hidden)
        script.set_up.push_back("_-Hide \"" + name + "\"");
    for (const std::string& line : {
             "_-ViewportSize " + std::to_string(request.size.width_px) + " " +
                 std::to_string(request.size.height_px),
             camera(request),
             fitView(request),
             "_-AnimationName \"" + request.name + "\"",
             setTurntable(request),
         })
        script.set_up.push_back(line);
    if (!request.document.empty())
        script.saving = "_-SaveAs " + quotedPath(request.document);
    script.recording = "_-RecordAnimation _TargetFolder " + quotedPath(request.folder) + " _Enter";
    return script;
}

} // namespace quarn::program
