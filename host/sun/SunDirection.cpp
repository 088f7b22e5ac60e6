#include "host/sun/SunDirection.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {
namespace {

constexpr double RADIANS_PER_DEGREE = std::numbers::pi / 180;

/// Below it a direction is straight up or down but for rounding.
constexpr double SMALLEST_SLANT = 1e-12;

} // namespace

KM_3dVector directionToSun(const SunPosition& position) {
    const double azimuth = position.azimuth_deg * RADIANS_PER_DEGREE;
    const double altitude = position.altitude_deg * RADIANS_PER_DEGREE;
    return {std::sin(azimuth) * std::cos(altitude), std::cos(azimuth) * std::cos(altitude),
            std::sin(altitude)};
}

SunPosition positionOfSun(const KM_3dVector& direction) {
    const double level = std::hypot(direction.x, direction.y);
    const double altitude = std::atan2(direction.z, level) / RADIANS_PER_DEGREE;
    if (level < SMALLEST_SLANT)
        return {0, altitude};
    const double azimuth = std::atan2(direction.x, direction.y) / RADIANS_PER_DEGREE;
    // A turn added to a hair less than north is a whole turn.
    return {std::fmod(azimuth + 360, 360), altitude};
}

} // namespace quarn
