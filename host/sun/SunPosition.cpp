#include "host/sun/SunPosition.h"

#include <cmath>
#include <erfa.h>
#include <erfam.h>

namespace quarn {
namespace {

/// How far the even time of the planets' motions is ahead of the time by the earth's rotation:
/// terrestrial time minus universal time (delta T), as it is in the 2020s. It was 14 seconds in
/// 1800 and is expected to be some 440 in 2199 (F. Espenak and J. Meeus, Five Millennium Canon of
/// Solar Eclipses, NASA/TP-2006-214141): the sun then stands a quarter of an arc-minute elsewhere.
constexpr double earth_rotation_delay_s = 69.2;

/// Julian day number of the midnight that began 1 January 1970.
constexpr double EPOCH_JULIAN_DAY = 2440587.5;

/// A moment of terrestrial time, in two parts so that no digits are lost.
struct Moment {
    double day;
    double fraction;
};

/// The place and the motion of the earth, in astronomical units and days.
struct Earth {
    double from_sun[2][3];
    double from_barycentre[2][3];

    explicit Earth(const Moment& moment) {
        // Its only warning is of years outside 1900 to 2100, where the error grows from some ten
        // kilometres to a few tens: nothing at the distance of the sun.
        eraEpv00(moment.day, moment.fraction, from_sun, from_barycentre);
    }
};

/// Universal time as the Julian day number of a midnight and a part of a day.
struct UniversalTime {
    double day;
    double fraction;

    explicit UniversalTime(std::chrono::sys_seconds utc) {
        const auto midnight = std::chrono::floor<std::chrono::days>(utc);
        day = EPOCH_JULIAN_DAY + static_cast<double>(midnight.time_since_epoch().count());
        fraction = static_cast<double>((utc - midnight).count()) / ERFA_DAYSEC;
    }
};

Moment momentOf(double ut_day, double ut_fraction) {
    return {ut_day, ut_fraction + earth_rotation_delay_s / ERFA_DAYSEC};
}

/// What the sky of the site looks like at the moment: where the observer is and how the local
/// horizon lies among the stars.
eraASTROM skyOf(const SunSite& site, const Moment& moment, Earth& earth, double rotation) {
    // The short series of the nutation is good to 0.001 arc-seconds, and quick.
    double celestial[3][3];
    eraPnm00b(moment.day, moment.fraction, celestial);
    double x = 0;
    double y = 0;
    eraBpn2xy(celestial, &x, &y);
    eraASTROM sky;
    eraApco(moment.day, moment.fraction, earth.from_barycentre, earth.from_sun[0], x, y,
            eraS00(moment.day, moment.fraction, x, y), rotation, site.longitude_deg * ERFA_DD2R,
            site.latitude_deg * ERFA_DD2R, 0, 0, 0, eraSp00(moment.day, moment.fraction), 0, 0,
            &sky);
    return sky;
}

/// The direction in which the light of the sun arrives, among the stars as they stand still.
void naturalDirection(const Earth& earth, const eraASTROM& sky, double (&direction)[3]) {
    // The light left the sun some 500 seconds ago. Since then the sun has gone a few kilometres
    // about the barycentre, on a line as good as straight.
    const double light_days = sky.em * ERFA_AULT / ERFA_DAYSEC;
    for (int axis = 0; axis < 3; ++axis) {
        const double sun_now = earth.from_barycentre[0][axis] - earth.from_sun[0][axis];
        const double sun_speed = earth.from_barycentre[1][axis] - earth.from_sun[1][axis];
        direction[axis] = sun_now - light_days * sun_speed - sky.eb[axis];
    }
    double distance = 0;
    eraPn(direction, &distance, direction);
}

} // namespace

SunPosition sunPosition(const SunSite& site, double ut_day, double ut_fraction) {
    const Moment moment = momentOf(ut_day, ut_fraction);
    Earth earth(moment);
    eraASTROM sky = skyOf(site, moment, earth, eraEra00(ut_day, ut_fraction));

    double natural[3];
    naturalDirection(earth, sky, natural);
    double proper[3];
    eraAb(natural, sky.v, sky.em, sky.bm1, proper);
    double of_date[3];
    eraRxp(sky.bpn, proper, of_date);
    double right_ascension = 0;
    double declination = 0;
    eraC2s(of_date, &right_ascension, &declination);

    double azimuth = 0;
    double zenith_distance = 0;
    double unused[3];
    eraAtioq(right_ascension, declination, &sky, &azimuth, &zenith_distance, &unused[0], &unused[1],
             &unused[2]);
    return {azimuth * ERFA_DR2D, 90 - zenith_distance * ERFA_DR2D};
}

SunPosition sunPosition(const SunSite& site, std::chrono::sys_seconds utc) {
    const UniversalTime time(utc);
    return sunPosition(site, time.day, time.fraction);
}

double sunLongitude(std::chrono::sys_seconds utc) {
    const UniversalTime time(utc);
    const Moment moment = momentOf(time.day, time.fraction);
    const Earth earth(moment);
    double natural[3];
    double speed[3]; // in units of that of light
    double distance = 0;
    for (int axis = 0; axis < 3; ++axis) {
        natural[axis] = -earth.from_sun[0][axis];
        speed[axis] = earth.from_barycentre[1][axis] * ERFA_AULT / ERFA_DAYSEC;
    }
    eraPn(natural, &distance, natural);
    double proper[3];
    eraAb(natural, speed, distance, std::sqrt(1 - eraPdp(speed, speed)), proper);

    double nutation = 0;
    double obliquity_change = 0;
    eraNut00b(moment.day, moment.fraction, &nutation, &obliquity_change);
    double equator[3][3];
    eraPnm00b(moment.day, moment.fraction, equator);
    eraRx(eraObl06(moment.day, moment.fraction) + obliquity_change, equator);
    double of_date[3];
    eraRxp(equator, proper, of_date);
    return eraAnp(std::atan2(of_date[1], of_date[0])) * ERFA_DR2D;
}

} // namespace quarn
