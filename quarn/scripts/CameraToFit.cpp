#include "quarn/scripts/CameraToFit.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn::program {

namespace {

constexpr double radians(double degrees) {
    return degrees * std::numbers::pi / 180.0;
}

/// The distance grows with the coordinates so that no digit of the direction is lost.
Triple cameraLocation(const Triple& target, double azimuth_deg, double elevation_deg) {
    const double distance =
        std::max({1.0, std::abs(target[0]), std::abs(target[1]), std::abs(target[2])});
    const double elevation = radians(elevation_deg);
    const double level = distance * std::cos(elevation);
    return {target[0] + level * std::cos(radians(azimuth_deg)),
            target[1] + level * std::sin(radians(azimuth_deg)),
            target[2] + distance * std::sin(elevation)};
}

} // namespace

std::string cameraToBeFitted(const Triple& target, double azimuth_deg, double elevation_deg,
                             const std::optional<double>& lens_mm) {
    return "_-Camera _Location " + tripleText(cameraLocation(target, azimuth_deg, elevation_deg)) +
           " _Target " + tripleText(target) + (lens_mm ? lensAnswer(*lens_mm) : "") + " _Enter";
}

std::string lensAnswer(double lens_mm) {
    return " _Parallel=No _Lens " + numberText(lens_mm);
}

} // namespace quarn::program
