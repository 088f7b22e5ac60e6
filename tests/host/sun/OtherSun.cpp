#include "tests/host/sun/OtherSun.h"

#include <cmath>
#include <erfa.h>
#include <erfam.h>

namespace quarn {
namespace {

/// Terrestrial time minus universal time, as the host takes it in all years.
constexpr double DELAY_S = 69.2;
constexpr double EPOCH_JULIAN_DAY = 2440587.5;

/// From the earth to the sun, among the stars; astronomical units.
void fromEarth(double tt_day, double tt_fraction, double (&sun)[3]) {
    constexpr int EARTH_AND_MOON = 3;
    constexpr double MOON_SHARE = 1 / (1 + 81.300569); // of their mass
    double both[2][3];
    double moon[2][3];
    eraPlan94(tt_day, tt_fraction, EARTH_AND_MOON, both);
    eraMoon98(tt_day, tt_fraction, moon);
    for (int axis = 0; axis < 3; ++axis)
        sun[axis] = MOON_SHARE * moon[0][axis] - both[0][axis];
}

} // namespace

OtherSun::OtherSun(std::chrono::sys_seconds utc) {
    const double days = static_cast<double>(utc.time_since_epoch().count()) / ERFA_DAYSEC;
    const double delay = DELAY_S / ERFA_DAYSEC;
    double sun[3];
    fromEarth(EPOCH_JULIAN_DAY, days + delay, sun);
    const double distance = eraPm(sun);

    double equator[3][3];
    eraPnm06a(EPOCH_JULIAN_DAY, days + delay, equator);
    double nutation = 0;
    double obliquity_change = 0;
    eraNut06a(EPOCH_JULIAN_DAY, days + delay, &nutation, &obliquity_change);
    const double obliquity = eraObl06(EPOCH_JULIAN_DAY, days + delay) + obliquity_change;
    double ecliptic[3][3];
    eraCr(equator, ecliptic);
    eraRx(obliquity, ecliptic);
    eraRxp(ecliptic, sun, sun);
    // The constant of aberration is 20.49552 seconds of arc.
    const double longitude = std::atan2(sun[1], sun[0]) - 20.49552 * ERFA_DAS2R / distance;
    const double latitude = std::asin(sun[2] / distance);
    longitude_deg = eraAnp(longitude) * ERFA_DR2D;

    double direction[3];
    eraS2c(longitude, latitude, direction);
    double to_equator[3][3];
    eraIr(to_equator);
    eraRx(-obliquity, to_equator);
    eraRxp(to_equator, direction, direction);
    declination_deg = std::asin(direction[2]) * ERFA_DR2D;
    greenwich_hour_angle_deg = (eraGst06a(EPOCH_JULIAN_DAY, days, EPOCH_JULIAN_DAY, days + delay) -
                                std::atan2(direction[1], direction[0])) *
                               ERFA_DR2D;
}

double OtherSun::hourAngle(double longitude) const {
    return std::remainder(greenwich_hour_angle_deg + longitude, 360);
}

double OtherSun::altitude(const SunSite& site) const {
    const double phi = site.latitude_deg * ERFA_DD2R;
    const double delta = declination_deg * ERFA_DD2R;
    const double cosine = std::cos(hourAngle(site.longitude_deg) * ERFA_DD2R);
    return std::asin(std::sin(phi) * std::sin(delta) + std::cos(phi) * std::cos(delta) * cosine) *
           ERFA_DR2D;
}

} // namespace quarn
