#include "sdk/zel/QnZelSun.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

constexpr double PI = 3.14159265358979323846;

/// The angle at which the radius of the earth is seen from the sun (IAU 1976 constants): by so much
/// a sun at the horizon stands lower for an observer than for the earth's centre.
constexpr double PARALLAX_DEG = 8.794148 / 3600;

double hoursOf(int hour, int minute, double second = 0) {
    return hour + minute / 60.0 + second / 3600;
}

struct Date {
    int year;
    int month;
    int day;
};

CQnZelSun sunAt(double latitude, double longitude, int zone, const Date& date, double hours) {
    CQnZelSun sun;
    sun.SetLatitude(latitude);
    sun.SetLongitude(longitude);
    sun.SetTimeZone(zone);
    sun.SetLocalDateTime(date.year, date.month, date.day, hours);
    return sun;
}

/// At the north pole the sun's altitude is its declination, less the parallax.
double declination(const Date& date, double hours) {
    const double altitude = sunAt(90, 0, 0, date, hours).Altitude();
    return altitude + PARALLAX_DEG * std::cos(altitude * PI / 180);
}

void expectSamePosition(const CQnZelSun& one, const CQnZelSun& other, double tolerance) {
    EXPECT_NEAR(std::remainder(one.Azimuth() - other.Azimuth(), 360), 0, tolerance);
    EXPECT_NEAR(one.Altitude(), other.Altitude(), tolerance);
}

void expectNoPosition(const CQnZelSun& sun) {
    EXPECT_TRUE(std::isnan(sun.Azimuth()));
    EXPECT_TRUE(std::isnan(sun.Altitude()));
}

// I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications
// (NREL/TP-560-34302), appendix A.5: azimuth 194.34024, zenith distance 50.11162 with refraction
// at 820 mbar and 11 degrees Celsius, altitude before refraction 39.872046.
TEST(ZelSun, StandsWhereTheWorkedExampleOfTheSolarPositionAlgorithmPutsIt) {
    const CQnZelSun sun = sunAt(39.742476, -105.1786, -7, {2003, 10, 17}, hoursOf(12, 30, 30));
    EXPECT_NEAR(sun.Azimuth(), 194.34024, 0.001);
    EXPECT_NEAR(sun.Altitude(), 39.872046, 0.001);
    // Equation 42 of the report, the refraction, leads to its zenith distance.
    const double argument = sun.Altitude() + 10.3 / (sun.Altitude() + 5.11);
    const double refraction =
        820 / 1010.0 * 283 / (273 + 11) * 1.02 / (60 * std::tan(argument * PI / 180));
    EXPECT_NEAR(90 - sun.Altitude() - refraction, 50.11162, 0.001);
}

// Jean Meeus, Astronomical Algorithms, 2nd edition, example 25.b: 13 October 1992 at 0h terrestrial
// time, which was 59 seconds ahead of universal time; apparent declination -7 deg 47' 01.74".
TEST(ZelSun, HasThePublishedDeclinationOfOctober1992) {
    EXPECT_NEAR(declination({1992, 10, 12}, hoursOf(23, 59, 1)), -(7 + 47 / 60.0 + 1.74 / 3600),
                0.001);
}

/// Where spherical astronomy puts a body of the given declination and local hour angle (west
/// positive), all in degrees.
struct HorizontalPlace {
    double azimuth;
    double altitude;
};

HorizontalPlace placeOf(double latitude, double declination, double hour_angle) {
    const double phi = latitude * PI / 180;
    const double delta = declination * PI / 180;
    const double h = hour_angle * PI / 180;
    const double altitude =
        std::asin(std::sin(phi) * std::sin(delta) + std::cos(phi) * std::cos(delta) * std::cos(h));
    const double from_south =
        std::atan2(std::sin(h), std::cos(h) * std::sin(phi) - std::tan(delta) * std::cos(phi));
    return {from_south * 180 / PI + 180, altitude * 180 / PI};
}

// Jean Meeus, Astronomical Algorithms, 2nd edition, examples 25.b and 28.a: at that moment the sun
// stood at the declination -7 deg 47' 01.74", and a sundial was 3.427351 degrees ahead of the
// clock.
TEST(ZelSun, StandsWhereThePublishedEquationOfTimePutsItAtEveryLatitudeAndHour) {
    const double published_declination = -(7 + 47 / 60.0 + 1.74 / 3600);
    const double published_equation = 3.427351;
    const double greenwich = 15 * (24 - 59 / 3600.0) - 180 + published_equation;
    for (const double latitude : {-66.0, -34.0, 1.0, 23.0, 52.0, 70.0})
        for (const double longitude : {-150.0, -105.0, -60.0, 0.0, 45.0, 120.0, 165.0}) {
            const CQnZelSun sun = sunAt(latitude, longitude, 0, {1992, 10, 12}, hoursOf(23, 59, 1));
            const HorizontalPlace place =
                placeOf(latitude, published_declination, greenwich + longitude);
            const double cosine = std::cos(place.altitude * PI / 180);
            EXPECT_NEAR(sun.Altitude(), place.altitude - PARALLAX_DEG * cosine, 0.001)
                << latitude << " " << longitude;
            EXPECT_NEAR(std::remainder(sun.Azimuth() - place.azimuth, 360) * cosine, 0, 0.001)
                << latitude << " " << longitude;
        }
}

// "Earth's Seasons", U.S. Naval Observatory: universal time to the minute, in which the declination
// changes by 0.0003 degrees.
TEST(ZelSun, CrossesTheEquatorAtThePublishedEquinoxes) {
    const struct {
        Date date;
        int hour, minute;
    } equinoxes[] = {
        {{2000, 3, 20}, 7, 35}, {{2000, 9, 22}, 17, 28}, {{2010, 3, 20}, 17, 32},
        {{2010, 9, 23}, 3, 9},  {{2020, 3, 20}, 3, 50},  {{2020, 9, 22}, 13, 31},
        {{2021, 3, 20}, 9, 37}, {{2021, 9, 22}, 19, 21}, {{2022, 3, 20}, 15, 33},
        {{2022, 9, 23}, 1, 4},  {{2023, 3, 20}, 21, 24}, {{2023, 9, 23}, 6, 50},
        {{2024, 3, 20}, 3, 6},  {{2024, 9, 22}, 12, 44},
    };
    for (const auto& [date, hour, minute] : equinoxes)
        EXPECT_NEAR(declination(date, hoursOf(hour, minute)), 0, 0.001) << date.year;
}

// The mean obliquity by J. Lieske and others (1977), 84381.448" - 46.8150" T; nutation moves the
// true one by up to 9.6", the sun's latitude is below 1.2".
TEST(ZelSun, ReachesTheObliquityOfTheEclipticAtTheSolsticesOfFourCenturies) {
    for (const int year : {1800, 1850, 1900, 1950, 2000, 2050, 2100, 2150, 2199}) {
        double highest = -90;
        double lowest = 90;
        for (int day = 18; day <= 24; ++day) {
            for (int hour = 0; hour < 24; ++hour) {
                highest = std::max(highest, declination({year, 6, day}, hour));
                lowest = std::min(lowest, declination({year, 12, day}, hour));
            }
        }
        const double obliquity = (84381.448 - 46.8150 * (year - 1999.5) / 100) / 3600;
        EXPECT_NEAR(highest, obliquity, 0.0031) << year;
        EXPECT_NEAR(lowest, -obliquity, 0.0031) << year;
    }
}

/// Jean Meeus, Astronomical Algorithms, chapters 12, 13, 22 and 25, the formulas of low accuracy:
/// the sun's direction (east, north, up) to 0.01 degrees, seen from the earth's centre.
struct Direction {
    double east, north, up;
};

Direction directionByMeeus(double latitude_deg, double longitude_deg, double universal_day,
                           double delay_s) {
    const auto sine = [](double degrees) { return std::sin(degrees * PI / 180); };
    const auto cosine = [](double degrees) { return std::cos(degrees * PI / 180); };
    const double t = (universal_day + delay_s / 86400 - 2451545) / 36525;
    const double mean_longitude = 280.46646 + 36000.76983 * t + 0.0003032 * t * t;
    const double anomaly = 357.52911 + 35999.05029 * t - 0.0001537 * t * t;
    const double centre = (1.914602 - 0.004817 * t) * sine(anomaly) +
                          (0.019993 - 0.000101 * t) * sine(2 * anomaly) +
                          0.000289 * sine(3 * anomaly);
    const double node = 125.04 - 1934.136 * t;
    const double longitude = mean_longitude + centre - 0.00569 - 0.00478 * sine(node);
    const double obliquity = 23.4392911 - 0.0130042 * t + 0.00256 * cosine(node);
    const double ascension =
        std::atan2(cosine(obliquity) * sine(longitude), cosine(longitude)) * 180 / PI;
    const double declination = std::asin(sine(obliquity) * sine(longitude)) * 180 / PI;
    const double days = universal_day - 2451545;
    const double sidereal =
        280.46061837 + 360.98564736629 * days + 0.000387933 * days * days / (36525.0 * 36525.0);
    const double hour_angle = sidereal + longitude_deg - ascension;
    return {-cosine(declination) * sine(hour_angle),
            sine(declination) * cosine(latitude_deg) -
                cosine(declination) * cosine(hour_angle) * sine(latitude_deg),
            sine(declination) * sine(latitude_deg) +
                cosine(declination) * cosine(hour_angle) * cosine(latitude_deg)};
}

Direction directionOf(const CQnZelSun& sun) {
    const double azimuth = sun.Azimuth() * PI / 180;
    const double altitude = sun.Altitude() * PI / 180;
    return {std::sin(azimuth) * std::cos(altitude), std::cos(azimuth) * std::cos(altitude),
            std::sin(altitude)};
}

double degreesBetween(const Direction& one, const Direction& other) {
    return std::hypot(one.east - other.east, one.north - other.north, one.up - other.up) * 180 / PI;
}

// The difference of terrestrial and universal time at the middle of these years, from the tables
// that Meeus prints in chapter 10; 1 January is day 2451544.5 in 2000.
TEST(ZelSun, AgreesWithTheFormulasOfLowAccuracyAtEveryLongitudeAndItsZone) {
    const struct {
        int year;
        double first_day, delay_s;
    } years[] = {{1800, 2378496.5, 14},
                 {1900, 2415020.5, -3},
                 {1950, 2433282.5, 29},
                 {1980, 2444239.5, 51},
                 {2000, 2451544.5, 64}};
    for (const auto& [year, first_day, delay_s] : years) {
        for (int longitude = -360; longitude <= 360; longitude += 15) {
            for (const double latitude : {-90.0, -66.0, -23.0, 0.0, 10.0, 51.5, 80.0}) {
                const int zone = longitude / 15;
                const double hours = (longitude + 360) % 24 + 0.25;
                const CQnZelSun sun = sunAt(latitude, longitude, zone, {year, 1, 31}, hours);
                const double day = first_day + 30 + (hours - zone) / 24;
                EXPECT_LT(degreesBetween(directionOf(sun),
                                         directionByMeeus(latitude, longitude, day, delay_s)),
                          0.015)
                    << year << ' ' << latitude << ' ' << longitude;
            }
        }
    }
}

TEST(ZelSun, TheSameMomentInAnotherZoneIsTheSamePosition) {
    const CQnZelSun universal = sunAt(48, 11, 0, {2026, 2, 28}, 23.5);
    expectSamePosition(universal, sunAt(48, 11, 1, {2026, 3, 1}, 0.5), 1e-7);
    expectSamePosition(universal, sunAt(48, 11, -12, {2026, 2, 28}, 11.5), 1e-7);
    expectSamePosition(universal, sunAt(48, 11, 24, {2026, 3, 1}, 23.5), 1e-7);
    expectSamePosition(universal, sunAt(48, 11, -24, {2026, 2, 27}, 23.5), 1e-7);
}

TEST(ZelSun, AWholeTurnOfLongitudeLeadsToTheSamePlace) {
    for (const int longitude : {-360, -300, -180, -105, -1, 0})
        expectSamePosition(sunAt(-33.9, longitude, 3, {2026, 6, 21}, 9),
                           sunAt(-33.9, longitude + 360, 3, {2026, 6, 21}, 9), 1e-9);
}

TEST(ZelSun, HourTwentyFourIsMidnightOfTheNextDay) {
    expectSamePosition(sunAt(60, 25, 2, {2199, 6, 30}, 24), sunAt(60, 25, 2, {2199, 7, 1}, 0),
                       1e-5);
    expectSamePosition(sunAt(60, 25, 2, {2024, 2, 28}, 24), sunAt(60, 25, 2, {2024, 2, 29}, 0),
                       1e-5);
}

// On the equator a rising sun stands north of east by its declination, at most 0.25 degrees here.
TEST(ZelSun, StandsInTheEastInTheMorningAndBelowTheHorizonAtMidnight) {
    EXPECT_NEAR(sunAt(0, 0, 0, {2024, 3, 20}, hoursOf(6, 30)).Azimuth(), 90, 0.3);
    EXPECT_NEAR(sunAt(0, 0, 0, {2024, 3, 20}, hoursOf(18, 0)).Azimuth(), 270, 0.3);
    EXPECT_LT(sunAt(0, 0, 0, {2024, 3, 20}, 0).Altitude(), -80);
}

TEST(ZelSun, EachReadingAnswersForWhatWasSetLast) {
    CQnZelSun sun = sunAt(0, 0, 0, {2024, 3, 20}, 12);
    const auto expect_position_of = [&sun](const CQnZelSun& fresh) {
        EXPECT_EQ(sun.Azimuth(), fresh.Azimuth());
        EXPECT_EQ(sun.Altitude(), fresh.Altitude());
    };
    const double first = sun.Altitude();
    sun.SetLatitude(40);
    EXPECT_LT(sun.Altitude(), first - 30);
    expect_position_of(sunAt(40, 0, 0, {2024, 3, 20}, 12));
    sun.SetLongitude(30);
    expect_position_of(sunAt(40, 30, 0, {2024, 3, 20}, 12));
    sun.SetTimeZone(2);
    expect_position_of(sunAt(40, 30, 2, {2024, 3, 20}, 12));
    sun.SetLocalDateTime(2024, 6, 20, 9);
    expect_position_of(sunAt(40, 30, 2, {2024, 6, 20}, 9));
}

TEST(ZelSun, HasAPositionFromTheFirstDayToTheLast) {
    EXPECT_LT(sunAt(90, 0, 24, {1800, 1, 1}, 0).Altitude(), -22);
    EXPECT_LT(sunAt(90, 0, -24, {2199, 12, 31}, 24).Altitude(), -22);
    EXPECT_GE(sunAt(-90, 360, 24, {1800, 1, 1}, 0).Azimuth(), 0);
}

TEST(ZelSun, IsNoLongerWhereItWasOnceTheDateIsImpossible) {
    CQnZelSun sun = sunAt(48, 11, 1, {2026, 4, 30}, 12);
    EXPECT_GT(sun.Altitude(), 40);
    const Date impossible[] = {{2026, 4, 31}, {2026, 2, 29},  {1900, 2, 29}, {2026, 0, 1},
                               {2026, 13, 1}, {2026, 1, 0},   {2026, 1, 32}, {1799, 12, 31},
                               {2200, 1, 1},  {2026, 257, 1}, {2026, 1, 257}};
    for (const Date& date : impossible) {
        SCOPED_TRACE(date.year * 10000 + date.month * 100 + date.day);
        sun.SetLocalDateTime(date.year, date.month, date.day, 12);
        expectNoPosition(sun);
    }
    sun.SetLocalDateTime(2026, 4, 30, 12);
    EXPECT_GT(sun.Altitude(), 40);
}

TEST(ZelSun, HasNoPositionForAPlaceOrATimeThatDoesNotExist) {
    constexpr double not_a_number = std::numeric_limits<double>::quiet_NaN();
    const Date date{2026, 6, 21};
    expectNoPosition(sunAt(90.001, 0, 0, date, 12));
    expectNoPosition(sunAt(-90.001, 0, 0, date, 12));
    expectNoPosition(sunAt(not_a_number, 0, 0, date, 12));
    expectNoPosition(sunAt(0, 360.001, 0, date, 12));
    expectNoPosition(sunAt(0, -std::numeric_limits<double>::infinity(), 0, date, 12));
    expectNoPosition(sunAt(0, 0, 25, date, 12));
    expectNoPosition(sunAt(0, 0, std::numeric_limits<int>::min(), date, 12));
    expectNoPosition(sunAt(0, 0, 0, date, -0.001));
    expectNoPosition(sunAt(0, 0, 0, date, 24.001));
    expectNoPosition(sunAt(0, 0, 0, date, not_a_number));
}

} // namespace
