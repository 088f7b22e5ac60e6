#include "host/sunpath/SkyDisk.h"

#include <cmath>
#include <numbers>

namespace quarn {
namespace {

constexpr double RADIANS_PER_DEGREE = std::numbers::pi / 180;

DrawnPoint polar(const DrawnPoint& middle, double azimuth_deg, double radius_px) {
    const double azimuth = azimuth_deg * RADIANS_PER_DEGREE;
    return {middle.x_px + radius_px * std::sin(azimuth),
            middle.y_px - radius_px * std::cos(azimuth)};
}

} // namespace

double SkyDisk::radiusOf(double altitude_deg) const {
    const double altitude = altitude_deg * RADIANS_PER_DEGREE;
    if (projection == SkyProjection::orthographic)
        return radius_px * std::cos(altitude);
    return radius_px * std::tan((std::numbers::pi / 2 - altitude) / 2);
}

DrawnPoint SkyDisk::at(const SunPosition& direction) const {
    return polar(middle, direction.azimuth_deg, radiusOf(direction.altitude_deg));
}

DrawnPoint SkyDisk::onRim(double azimuth_deg, double beyond_px) const {
    return polar(middle, azimuth_deg, radius_px + beyond_px);
}

} // namespace quarn
