#include "zoetrix/sun/SunPoint.h"
#include "sdk/zel/QnZelSun.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

constexpr double pi = 3.141592653589793;
constexpr double not_a_number = std::numeric_limits<double>::quiet_NaN();
constexpr double infinite = std::numeric_limits<double>::infinity();

void expectNear(const KM_3dVector& found, const KM_3dVector& wanted) {
    EXPECT_NEAR(found.x, wanted.x, 1e-12);
    EXPECT_NEAR(found.y, wanted.y, 1e-12);
    EXPECT_NEAR(found.z, wanted.z, 1e-12);
}

/// By the definition of the horizontal coordinates.
KM_3dVector directionOf(double azimuth_deg, double altitude_deg) {
    const double azimuth = azimuth_deg * pi / 180.0;
    const double altitude = altitude_deg * pi / 180.0;
    return {std::cos(altitude) * std::sin(azimuth), std::cos(altitude) * std::cos(azimuth),
            std::sin(altitude)};
}

KM_3dVector sunPoint(double north_angle, double latitude, double longitude) {
    return KM_3dVector(
        CZoetrixUtilities::GetSunPoint(9, 20, 2026, 6, 21, north_angle, latitude, longitude));
}

/// The host's sun for the same moment in a zone that the test names.
KM_3dVector hostSun(int zone, double latitude, double longitude) {
    CQnZelSun sun;
    sun.SetLatitude(latitude);
    sun.SetLongitude(longitude);
    sun.SetTimeZone(zone);
    sun.SetLocalDateTime(2026, 6, 21, 9.0 + 20.0 / 60.0);
    return directionOf(sun.Azimuth(), sun.Altitude());
}

bool hasSunAt(int hour, int year, int month, int day, double latitude, double longitude) {
    return CZoetrixUtilities::GetSunPoint(hour, 0, year, month, day, 0.0, latitude, longitude)
        .IsValid();
}

TEST(SunPoint, ASunOnTheHorizonLiesAlongTheWorldAxes) {
    expectNear(DirectionToSun(0.0, 0.0), {0.0, 1.0, 0.0});
    expectNear(DirectionToSun(90.0, 0.0), {1.0, 0.0, 0.0});
    expectNear(DirectionToSun(180.0, 0.0), {0.0, -1.0, 0.0});
    expectNear(DirectionToSun(270.0, 0.0), {-1.0, 0.0, 0.0});
}

TEST(SunPoint, ASunStraightUpIsUpWhateverTheAzimuth) {
    for (double azimuth = 0.0; azimuth < 360.0; azimuth += 17.0)
        expectNear(DirectionToSun(azimuth, 90.0), {0.0, 0.0, 1.0});
}

TEST(SunPoint, EveryDirectionIsThatOfItsHorizontalCoordinates) {
    for (double azimuth = -720.0; azimuth <= 720.0; azimuth += 12.5) {
        for (double altitude = -90.0; altitude <= 90.0; altitude += 7.5)
            expectNear(DirectionToSun(azimuth, altitude), directionOf(azimuth, altitude));
    }
}

TEST(SunPoint, WithoutAPositionThereIsNoDirection) {
    EXPECT_FALSE(DirectionToSun(not_a_number, 10.0).IsValid());
    EXPECT_FALSE(DirectionToSun(10.0, not_a_number).IsValid());
    EXPECT_FALSE(DirectionToSun(infinite, 10.0).IsValid());
}

TEST(SunPoint, ThePointIsWhereTheAlmanacPutsTheSun) {
    // I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications, NREL
    // 2003, appendix A.5: 17 October 2003, 12:30:30, seven hours behind universal time, azimuth
    // 194.34024, altitude before refraction 39.87205. Half a minute of time is an eighth of a
    // degree of hour angle, so the point lies between those of two whole minutes.
    const auto at = [](int minute) {
        return KM_3dVector(
            CZoetrixUtilities::GetSunPoint(12, minute, 2003, 10, 17, 0.0, 39.742476, -105.1786));
    };
    KM_3dVector between = at(30) + at(31);
    ASSERT_TRUE(between.Unitize());
    EXPECT_LT((between - directionOf(194.34024, 39.87205)).Length(), 0.001 * pi / 180.0);
}

TEST(SunPoint, TheZoneIsTheLongitudeInHoursWithoutItsFraction) {
    expectNear(sunPoint(0.0, 51.5, -0.12), hostSun(0, 51.5, -0.12));
    expectNear(sunPoint(0.0, 35.0, 139.7), hostSun(9, 35.0, 139.7));     // 9.31
    expectNear(sunPoint(0.0, 40.7, -74.0), hostSun(-4, 40.7, -74.0));    // -4.93
    expectNear(sunPoint(0.0, 40.7, 286.0), hostSun(19, 40.7, 286.0));    // 19.07
    expectNear(sunPoint(0.0, -33.9, -360.0), hostSun(-24, -33.9, -360)); // -24
}

TEST(SunPoint, TheNorthAngleTurnsTheSunClockwise) {
    CQnZelSun sun;
    sun.SetLatitude(51.5);
    sun.SetLocalDateTime(2026, 6, 21, 9.0 + 20.0 / 60.0);
    expectNear(sunPoint(30.0, 51.5, 0.0), directionOf(sun.Azimuth() + 30.0, sun.Altitude()));
}

TEST(SunPoint, ThePointIsAboveTheGroundByDayAndBelowByNight) {
    EXPECT_GT(CZoetrixUtilities::GetSunPoint(12, 0, 2026, 6, 21, 0.0, 51.5, 0.0).z, 0.8);
    EXPECT_LT(CZoetrixUtilities::GetSunPoint(0, 0, 2026, 6, 21, 0.0, 51.5, 0.0).z, 0.0);
}

TEST(SunPoint, WhatIsOutOfRangeHasNoPoint) {
    EXPECT_TRUE(hasSunAt(12, 2026, 4, 30, 51.5, 0.0));
    EXPECT_FALSE(hasSunAt(12, 2026, 4, 31, 51.5, 0.0));
    EXPECT_FALSE(hasSunAt(12, 1799, 4, 30, 51.5, 0.0));
    EXPECT_FALSE(hasSunAt(12, 2200, 4, 30, 51.5, 0.0));
    EXPECT_FALSE(hasSunAt(25, 2026, 4, 30, 51.5, 0.0));
    EXPECT_FALSE(hasSunAt(12, 2026, 4, 30, 90.5, 0.0));
    EXPECT_FALSE(hasSunAt(12, 2026, 4, 30, 51.5, 361.0));
    EXPECT_FALSE(hasSunAt(12, 2026, 4, 30, 51.5, 1e300));
    EXPECT_FALSE(hasSunAt(12, 2026, 4, 30, 51.5, not_a_number));
}

TEST(SunPoint, ADateThatDoesNotExistIsTheUnsetPoint) {
    EXPECT_EQ(CZoetrixUtilities::GetSunPoint(12, 0, 2026, 4, 31, 0.0, 51.5, 0.0),
              KM_3dPoint::UnsetPoint);
}

} // namespace
