#pragma once

#include "host/sun/SunPosition.h"

#include <chrono>

namespace quarn {

/// The sun as another theory of the earth's motion has it: mean elements of the planets with their
/// largest perturbations (J. L. Simon and others, Astronomy and Astrophysics 282, 1994), which ERFA
/// holds as eraPlan94 beside the series that the host takes. Seen from the earth's centre; good to
/// some seconds of arc in the years 1800 to 2199.
struct OtherSun {
    double longitude_deg;            ///< apparent
    double declination_deg;          ///< apparent
    double greenwich_hour_angle_deg; ///< west positive

    explicit OtherSun(std::chrono::sys_seconds utc);

    double hourAngle(double longitude_deg) const; ///< from -180 to 180
    double altitude(const SunSite& site) const;   ///< degrees, without parallax
};

} // namespace quarn
