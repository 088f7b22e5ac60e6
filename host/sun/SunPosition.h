#pragma once

#include "sdk/qncore/QnExport.h"

#include <chrono>

namespace quarn {

/// Where the sun's centre stands in the sky.
struct SunPosition {
    double azimuth_deg;  ///< clockwise from north, 0 up to but not including 360
    double altitude_deg; ///< above the horizon
};

/// A place on the ellipsoid of the earth, at sea level.
struct SunSite {
    double latitude_deg;  ///< geodetic, north positive, -90 to 90
    double longitude_deg; ///< east positive
};

/// Computes the apparent topocentric position of the sun without refraction: light time,
/// aberration, precession, nutation and parallax are in it. The delay of the earth's rotation is
/// that of the 2020s in all years: by that the sun stands at most 0.005 degrees elsewhere from 1800
/// to 2199.
///
/// @param ut_day       Julian day number of the midnight that `ut_fraction` counts from, UT1
/// @param ut_fraction  days since then; may lie outside 0 to 1
SunPosition sunPosition(const SunSite& site, double ut_day, double ut_fraction);

/// The same at an instant of universal time.
QNCORE_API SunPosition sunPosition(const SunSite& site, std::chrono::sys_seconds utc);

/// The apparent longitude of the sun, as seen from the middle of the earth: 0 at the equinox of
/// March, 90 at the solstice of June. The delay of the earth's rotation is that of sunPosition.
/// @return degrees along the ecliptic of date, 0 up to but not including 360
double sunLongitude(std::chrono::sys_seconds utc);

} // namespace quarn
