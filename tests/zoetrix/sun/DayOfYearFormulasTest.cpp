#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <gtest/gtest.h>

#include <cmath>

// Where no other source is named, the expected numbers are the formulas worked out with 30 digits
// for 21 June, day 172, at 39.742476 degrees north and 105.1786 degrees west, seven hours behind
// universal time:
//   g = 171 * 0.01721420632103996 = 2.943629280897833
//   declination = 0.4085388887547116, equation of time = -1.328236800222473 minutes
//   hour angle of 09:30 = (570 - 1.328236800222473 - 4 * 105.1786 + 420) / 4 - 180 degrees

namespace {

using Sun = CZoetrixUtilities;

constexpr double pi = 3.141592653589793;
constexpr int midsummer = 172;
constexpr double longitude = 105.1786;
constexpr double latitude = 39.742476;
constexpr double zone = 7.0;

double hourAngle(int hour, int minute, int second = 0) {
    return Sun::HourAngle(midsummer, hour, minute, second, longitude, zone);
}

double zenith(int hour, int minute) {
    return Sun::Zenith(midsummer, hour, minute, 0, longitude, latitude, zone);
}

double azimuth(int hour, int minute) {
    return Sun::Azimuth(midsummer, hour, minute, 0, longitude, latitude, zone);
}

TEST(DayOfYearFormulas, TheHourDoesNotMoveTheFractionOfTheYear) {
    EXPECT_EQ(Sun::Gamma(1, 0), 0.0);
    EXPECT_EQ(Sun::Gamma(1, 12), 0.0);
    EXPECT_EQ(Sun::Gamma(1, 23), 0.0);
    EXPECT_EQ(Sun::Gamma(2, 5), 0.01721420632103996);
    EXPECT_EQ(Sun::Gamma(midsummer, 3), Sun::Gamma(midsummer, 21));
}

TEST(DayOfYearFormulas, WholeDaysFromNoonCountAsDays) {
    EXPECT_EQ(Sun::Gamma(1, 36), 0.01721420632103996);
    EXPECT_EQ(Sun::Gamma(1, 35), 0.0);
    EXPECT_EQ(Sun::Gamma(2, -12), 0.0);
}

TEST(DayOfYearFormulas, AYearIsAFullTurn) {
    EXPECT_NEAR(Sun::Gamma(366, 0), 2.0 * pi, 1e-14);
}

TEST(DayOfYearFormulas, TheDeclinationOfNewYearIsTheSumOfTheCosines) {
    // All sines are 0 and all cosines 1: 0.006918 - 0.39912 - 0.006758 - 0.002697.
    EXPECT_NEAR(Sun::Declination(1, 0), -0.401657, 1e-15);
}

TEST(DayOfYearFormulas, TheDeclinationKeepsItsOwnFirstCoefficient) {
    EXPECT_NEAR(Sun::Declination(midsummer, 12), 0.4085388887547116, 1e-14);
    const double of_the_published_series = 0.409315420329718;
    EXPECT_NEAR(of_the_published_series - Sun::Declination(midsummer, 12), 0.0007765, 1e-7);
}

TEST(DayOfYearFormulas, TheDeclinationIsNearTheObliquityAtTheSolstices) {
    // The series is good to 0.035 degrees, the coefficient of its own adds 0.045.
    EXPECT_NEAR(Sun::Declination(midsummer, 12) * 180.0 / pi, 23.44, 0.08);
    EXPECT_NEAR(Sun::Declination(355, 12) * 180.0 / pi, -23.44, 0.08);
}

TEST(DayOfYearFormulas, TheArctangentGivesTheAngleOfACosine) {
    EXPECT_EQ(Sun::Arccos(1.0), 0.0);
    EXPECT_EQ(Sun::Arccos(-1.0), pi);
    EXPECT_EQ(Sun::Arccos(0.0), pi / 2.0);
    EXPECT_NEAR(Sun::Arccos(0.5), pi / 3.0, 1e-15);
    EXPECT_NEAR(Sun::Arccos(-0.5), 2.0 * pi / 3.0, 1e-15);
}

TEST(DayOfYearFormulas, NoAngleHasACosineBeyondOne) {
    EXPECT_TRUE(std::isnan(Sun::Arccos(1.0000001)));
    EXPECT_TRUE(std::isnan(Sun::Arccos(-1.0000001)));
}

TEST(DayOfYearFormulas, TheHourAngleOfNoonIsTheEquationOfTime) {
    // 1 January: 229.18 * (0.000075 + 0.001868 - 0.014615) = -2.90416896 minutes, a quarter of a
    // degree each.
    EXPECT_NEAR(Sun::HourAngle(1, 12, 0, 0, 0.0, 0.0), -2.90416896 / 4.0 * pi / 180.0, 1e-14);
}

TEST(DayOfYearFormulas, TheHourAngleIsNegativeBeforeNoon) {
    EXPECT_NEAR(hourAngle(9, 30), -0.6634111538944445, 1e-13);
    EXPECT_NEAR(hourAngle(15, 0), 0.7764854790008774, 1e-13);
}

TEST(DayOfYearFormulas, LongitudeAndZoneCountToTheWest) {
    // A degree to the west sees the sun 4 minutes later; who also sets the clock by it does not.
    const double here = Sun::HourAngle(midsummer, 12, 0, 0, 0.0, 0.0);
    EXPECT_NEAR(Sun::HourAngle(midsummer, 12, 0, 0, 1.0, 0.0), here - pi / 180.0, 1e-14);
    EXPECT_NEAR(Sun::HourAngle(midsummer, 12, 0, 0, 15.0, 1.0), here, 1e-14);
}

TEST(DayOfYearFormulas, SecondsCountInWholeMinutes) {
    EXPECT_EQ(hourAngle(12, 0, 59), hourAngle(12, 0));
    EXPECT_EQ(hourAngle(12, 0, 60), hourAngle(12, 1));
    EXPECT_EQ(hourAngle(12, 0, 119), hourAngle(12, 1));
}

TEST(DayOfYearFormulas, TheZenithAngleIsSmallestAtNoon) {
    EXPECT_NEAR(zenith(9, 30), 0.6267054671062691, 1e-13);
    EXPECT_NEAR(zenith(12, 0), 0.285197802950594, 1e-13);
    EXPECT_NEAR(zenith(15, 0), 0.7115009039729962, 1e-13);
}

TEST(DayOfYearFormulas, TheAzimuthCountsFromNorthToTheWest) {
    EXPECT_NEAR(azimuth(9, 30), 4.441728680536243, 1e-12); // 254.5 degrees: east-southeast
    EXPECT_NEAR(azimuth(15, 0), 1.744860617626117, 1e-12); // 100.0 degrees: west
}

TEST(DayOfYearFormulas, TheClockTellsTheMorningFromTheAfternoon) {
    // The arc is 0.029075 at 12:00 and 0.014843 at 12:01, with the sun still in the east.
    EXPECT_NEAR(azimuth(12, 0), 3.170667877264614, 1e-11);
    EXPECT_NEAR(azimuth(12, 1), 3.126749263170091, 1e-11);
    EXPECT_GT(azimuth(12, 0), pi);
    EXPECT_LT(azimuth(12, 1), pi);
}

TEST(DayOfYearFormulas, AtSunriseTheAzimuthDependsOnDeclinationAndLatitudeAlone) {
    // On the horizon the arc's cosine is -sin(declination) / cos(latitude), by the definition.
    for (int minute = 0; minute < 60; ++minute) {
        if (zenith(4, minute) < pi / 2.0) {
            const double expected = pi + std::acos(-std::sin(Sun::Declination(midsummer, 0)) /
                                                   std::cos(latitude * pi / 180.0));
            EXPECT_NEAR(azimuth(4, minute), expected, 0.005);
            return;
        }
    }
    FAIL() << "no sunrise between four and five";
}

} // namespace
