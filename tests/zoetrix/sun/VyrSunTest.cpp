#include "zoetrix/sun/VyrSun.h"

#include <gtest/gtest.h>

#include <cfenv>
#include <chrono>
#include <cmath>
#include <limits>
#include <random>
#include <type_traits>

// Where no other source is named, the expected numbers are the class's formulas worked out with 30
// digits, with the steps in comments.

namespace {

constexpr double not_a_number = std::numeric_limits<double>::quiet_NaN();
constexpr double infinite = std::numeric_limits<double>::infinity();

// J. Meeus, Astronomical Algorithms (2nd edition), example 25.a: 13 October 1992 at 0 hours.
constexpr double day_of_example = 2448908.5;

static_assert(std::has_virtual_destructor_v<CVyrSun>);

/// Counts the changes and keeps what is stale when it hears of one.
class WatchedSun final : public CVyrSun {
public:
    void Changed() override {
        ++changes;
        was_modified = IsModified();
        was_fast_modified = IsFastModified();
    }
    /// Computes everything, so that nothing is stale.
    void Settle() {
        UpdateIfModified();
        FastAltitude();
    }
    using CVyrSun::IsFastModified;
    using CVyrSun::IsModified;

    int changes = 0;
    bool was_modified = false;
    bool was_fast_modified = false;
};

/// Has the processor round up for as long as the object lives.
class RoundingUp {
public:
    RoundingUp() { std::fesetround(FE_UPWARD); }
    ~RoundingUp() { std::fesetround(FE_TONEAREST); }
    RoundingUp(const RoundingUp&) = delete;
    RoundingUp& operator=(const RoundingUp&) = delete;
};

CVyrSun sunOfExample(double latitude, double longitude) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetLocalJulianDay(day_of_example));
    EXPECT_TRUE(sun.SetLatitude(latitude));
    EXPECT_TRUE(sun.SetLongitude(longitude));
    return sun;
}

/// At the pole the altitude is the declination, whatever the hour.
double declinationAt(double julian_day) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetLatitude(90.0));
    EXPECT_TRUE(sun.SetLocalJulianDay(julian_day));
    return sun.Altitude();
}

struct DateTime {
    int year = 0;
    int month = 0;
    int day = 0;
    double hours = 0.0;
};

DateTime dateTimeOf(const CVyrSun& sun) {
    DateTime read;
    sun.LocalDateTime(read.year, read.month, read.day, read.hours);
    return read;
}

TEST(VyrSun, ANewSunStandsAtTheBeginningOfTheJulianDays) {
    const CVyrSun sun;
    EXPECT_EQ(sun.LocalJulianDay(), 0.0);
    EXPECT_EQ(sun.TimeZoneHours(), 0.0);
    EXPECT_EQ(sun.DaylightSavingMinutes(), 0);
    EXPECT_EQ(sun.JulianDay(), 0.0);
}

TEST(VyrSun, ANewSunHasAPosition) {
    // n = -2451545, T = -67.11964407939767, lambda = 245.0690964684458, epsilon =
    // 24.46760029416638, alpha = 242.9464298309797, delta = -22.06041944506583, theta0 =
    // 243.3434945468965. So many turns of sidereal time cost digits.
    const CVyrSun sun;
    EXPECT_NEAR(sun.Azimuth(), 180.9796903289937, 1e-5);
    EXPECT_NEAR(sun.Altitude(), 67.93618578920977, 1e-5);
    EXPECT_NEAR(sun.FastAltitude(), 68.20003620881202, 1e-5);
}

TEST(VyrSun, NoonOfTheFirstOfJanuary2000HasItsJulianDay) {
    CVyrSun sun;
    ASSERT_TRUE(sun.SetLocalDateTime(2000, 1, 1, 12.0));
    EXPECT_EQ(sun.LocalJulianDay(), 2451545.0);
    const DateTime read = dateTimeOf(sun);
    EXPECT_EQ(read.year, 2000);
    EXPECT_EQ(read.month, 1);
    EXPECT_EQ(read.day, 1);
    EXPECT_EQ(read.hours, 12.00000001);
}

TEST(VyrSun, PublishedJulianDaysAreMet) {
    // Meeus, chapter 7, the list behind example 7.b.
    const struct {
        int year, month, day;
        double hours, julian_day;
    } rows[] = {
        {1999, 1, 1, 0.0, 2451179.5},   {1987, 1, 27, 0.0, 2446822.5},
        {1987, 6, 19, 12.0, 2446966.0}, {1988, 1, 27, 0.0, 2447187.5},
        {1988, 6, 19, 12.0, 2447332.0}, {1900, 1, 1, 0.0, 2415020.5},
    };
    for (const auto& row : rows) {
        CVyrSun sun;
        EXPECT_TRUE(sun.SetLocalDateTime(row.year, row.month, row.day, row.hours));
        EXPECT_EQ(sun.LocalJulianDay(), row.julian_day);
    }
}

TEST(VyrSun, EveryDayOfFourCenturiesReadsBackAsItWasSet) {
    using namespace std::chrono;
    CVyrSun sun;
    for (sys_days date = 1800y / 1 / 1; date < sys_days(2200y / 1 / 1); date += days(1)) {
        const year_month_day wanted = date;
        const int year = static_cast<int>(wanted.year());
        const int month = static_cast<int>(static_cast<unsigned>(wanted.month()));
        const int day = static_cast<int>(static_cast<unsigned>(wanted.day()));
        ASSERT_TRUE(sun.SetLocalDateTime(year, month, day, 18.0)) << year << month << day;
        // Midnight of 1 January 1970 is Julian day 2440587.5.
        ASSERT_EQ(sun.LocalJulianDay(), 2440587.5 + date.time_since_epoch().count() + 0.75);
        const DateTime read = dateTimeOf(sun);
        ASSERT_EQ(sys_days(std::chrono::year(read.year) / read.month / read.day), date);
        ASSERT_EQ(read.hours, 18.00000001);
    }
}

TEST(VyrSun, AWholeHourNeverReadsBackBelowIt) {
    CVyrSun sun;
    for (int hour = 0; hour < 24; ++hour) {
        ASSERT_TRUE(sun.SetLocalDateTime(2026, 6, 21, hour));
        const DateTime read = dateTimeOf(sun);
        EXPECT_EQ(static_cast<int>(std::floor(read.hours + 1e-8)), hour);
        EXPECT_NEAR(read.hours, hour, 3e-8);
    }
}

TEST(VyrSun, TheTwentyFourthHourIsTheNextMidnight) {
    CVyrSun sun;
    ASSERT_TRUE(sun.SetLocalDateTime(2025, 12, 31, 24.0));
    const DateTime read = dateTimeOf(sun);
    EXPECT_EQ(read.year, 2026);
    EXPECT_EQ(read.month, 1);
    EXPECT_EQ(read.day, 1);
    EXPECT_EQ(read.hours, 1e-8);
}

TEST(VyrSun, FebruaryHasALeapDayByTheGregorianRule) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetLocalDateTime(2000, 2, 29, 0.0));
    EXPECT_TRUE(sun.SetLocalDateTime(2004, 2, 29, 0.0));
    EXPECT_FALSE(sun.SetLocalDateTime(1900, 2, 29, 0.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2100, 2, 29, 0.0));
    EXPECT_EQ(CVyrSun::DaysInMonth(2, 1900), 28);
    EXPECT_EQ(CVyrSun::DaysInMonth(2, 2000), 29);
    EXPECT_EQ(CVyrSun::DaysInMonth(2, 2004), 29);
    EXPECT_EQ(CVyrSun::DaysInMonth(2, 2026), 28);
}

TEST(VyrSun, EveryMonthHasItsDays) {
    const int days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    CVyrSun sun;
    for (int month = 1; month <= 12; ++month) {
        EXPECT_EQ(CVyrSun::DaysInMonth(month, 2026), days[month - 1]);
        EXPECT_TRUE(sun.SetLocalDateTime(2026, month, days[month - 1], 0.0));
        EXPECT_FALSE(sun.SetLocalDateTime(2026, month, days[month - 1] + 1, 0.0));
    }
}

TEST(VyrSun, DatesAndTimesOutOfRangeChangeNothing) {
    WatchedSun sun;
    ASSERT_TRUE(sun.SetLocalDateTime(2026, 6, 21, 14.5));
    sun.Settle();
    const double before = sun.LocalJulianDay();
    sun.changes = 0;
    EXPECT_FALSE(sun.SetLocalDateTime(1799, 12, 31, 12.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2200, 1, 1, 12.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 0, 1, 12.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 13, 1, 12.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 1, 0, 12.0));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 1, 1, std::nextafter(0.0, -1.0)));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 1, 1, std::nextafter(24.0, 25.0)));
    EXPECT_FALSE(sun.SetLocalDateTime(2026, 1, 1, not_a_number));
    EXPECT_FALSE(sun.SetLocalDateTime(2199, 12, 31, 24.0));
    EXPECT_EQ(sun.LocalJulianDay(), before);
    EXPECT_EQ(sun.changes, 0);
    EXPECT_FALSE(sun.IsModified());
    EXPECT_FALSE(sun.IsFastModified());
}

TEST(VyrSun, TheFirstAndTheLastMomentAreAccepted) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetLocalDateTime(1800, 1, 1, 0.0));
    EXPECT_EQ(sun.LocalJulianDay(), 2378496.5);
    EXPECT_TRUE(sun.SetLocalDateTime(2199, 12, 31, 23.9999));
    EXPECT_TRUE(sun.SetLocalJulianDay(2378496.5));
    EXPECT_FALSE(sun.SetLocalJulianDay(std::nextafter(2378496.5, 0.0)));
    EXPECT_TRUE(sun.SetLocalJulianDay(2524593.499999999));
    EXPECT_FALSE(sun.SetLocalJulianDay(std::nextafter(2524593.499999999, 3e6)));
    EXPECT_FALSE(sun.SetLocalJulianDay(not_a_number));
    EXPECT_EQ(sun.LocalJulianDay(), 2524593.499999999);
}

TEST(VyrSun, PlacesAndZonesAreAcceptedUpToTheirEndsAndNotAHairBeyond) {
    CVyrSun sun;
    const struct {
        bool (CVyrSun::*set)(double);
        double least;
        double greatest;
    } setters[] = {{&CVyrSun::SetLatitude, -90.0, 90.0},
                   {&CVyrSun::SetLongitude, -180.0, 180.0},
                   {&CVyrSun::SetTimeZoneHours, -12.0, 13.0}};
    for (const auto& [set, least, greatest] : setters) {
        EXPECT_TRUE((sun.*set)(least));
        EXPECT_TRUE((sun.*set)(greatest));
        EXPECT_FALSE((sun.*set)(std::nextafter(least, -infinite)));
        EXPECT_FALSE((sun.*set)(std::nextafter(greatest, infinite)));
        EXPECT_FALSE((sun.*set)(infinite));
        EXPECT_FALSE((sun.*set)(not_a_number));
    }
    EXPECT_EQ(sun.TimeZoneHours(), 13.0);
}

TEST(VyrSun, DaylightSavingIsAcceptedUpToTwoHours) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetDaylightSavingMinutes(120));
    EXPECT_FALSE(sun.SetDaylightSavingMinutes(121));
    EXPECT_FALSE(sun.SetDaylightSavingMinutes(-1));
    EXPECT_EQ(sun.DaylightSavingMinutes(), 120);
    EXPECT_TRUE(sun.SetDaylightSavingMinutes(0));
}

TEST(VyrSun, ARejectedPlaceLeavesThePositionAsItIs) {
    CVyrSun sun = sunOfExample(40.0, -75.0);
    const double azimuth = sun.Azimuth();
    const double fast = sun.FastAltitude();
    EXPECT_FALSE(sun.SetLatitude(91.0));
    EXPECT_FALSE(sun.SetLongitude(181.0));
    EXPECT_EQ(sun.Azimuth(), azimuth);
    EXPECT_EQ(sun.FastAltitude(), fast);
}

TEST(VyrSun, UniversalTimeIsLocalTimeLessZoneAndDaylightSaving) {
    CVyrSun sun;
    ASSERT_TRUE(sun.SetLocalJulianDay(2451545.0));
    ASSERT_TRUE(sun.SetTimeZoneHours(5.5));
    ASSERT_TRUE(sun.SetDaylightSavingMinutes(30));
    EXPECT_EQ(sun.JulianDay(), 2451544.75); // 12:00 less 6 hours
    EXPECT_EQ(sun.LocalJulianDay(), 2451545.0);
}

TEST(VyrSun, TheSameValueTwiceIsOneChange) {
    WatchedSun sun;
    EXPECT_TRUE(sun.SetLatitude(51.5));
    EXPECT_TRUE(sun.SetLatitude(51.5));
    EXPECT_EQ(sun.changes, 1);
    sun.Settle();
    EXPECT_TRUE(sun.SetLatitude(51.5));
    EXPECT_TRUE(sun.SetLongitude(0.0));
    EXPECT_TRUE(sun.SetTimeZoneHours(0.0));
    EXPECT_TRUE(sun.SetDaylightSavingMinutes(0));
    EXPECT_EQ(sun.changes, 1);
    EXPECT_FALSE(sun.IsModified());
    EXPECT_FALSE(sun.IsFastModified());
}

TEST(VyrSun, TheSameDateAndJulianDayTwiceAreOneChange) {
    WatchedSun sun;
    ASSERT_TRUE(sun.SetLocalDateTime(2000, 1, 1, 12.0));
    sun.Settle();
    EXPECT_TRUE(sun.SetLocalDateTime(2000, 1, 1, 12.0));
    EXPECT_TRUE(sun.SetLocalJulianDay(2451545.0)) << "noon of that day";
    EXPECT_EQ(sun.changes, 1);
    EXPECT_FALSE(sun.IsModified());
    EXPECT_FALSE(sun.IsFastModified());
}

TEST(VyrSun, PlacesLeaveTheCacheOfTheDateAlone) {
    WatchedSun sun;
    sun.Settle();
    ASSERT_TRUE(sun.SetLatitude(51.5));
    EXPECT_TRUE(sun.was_modified);
    EXPECT_FALSE(sun.was_fast_modified);
    sun.Settle();
    ASSERT_TRUE(sun.SetLongitude(-0.12));
    EXPECT_TRUE(sun.was_modified);
    EXPECT_FALSE(sun.was_fast_modified);
    EXPECT_EQ(sun.changes, 2);
}

TEST(VyrSun, EveryChangeOfTheTimeMakesBothCachesStale) {
    WatchedSun sun;
    const auto expectStale = [&](bool accepted) {
        EXPECT_TRUE(accepted);
        EXPECT_TRUE(sun.was_modified);
        EXPECT_TRUE(sun.was_fast_modified);
        sun.Settle();
        sun.was_modified = sun.was_fast_modified = false;
    };
    sun.Settle();
    expectStale(sun.SetTimeZoneHours(1.0));
    expectStale(sun.SetDaylightSavingMinutes(60));
    expectStale(sun.SetLocalDateTime(2026, 6, 21, 12.0));
    expectStale(sun.SetLocalJulianDay(2451545.0));
    EXPECT_EQ(sun.changes, 4);
}

TEST(VyrSun, EachPositionClearsItsOwnFlag) {
    WatchedSun sun;
    EXPECT_TRUE(sun.IsModified());
    EXPECT_TRUE(sun.IsFastModified());
    sun.FastAltitude();
    EXPECT_TRUE(sun.IsModified());
    EXPECT_FALSE(sun.IsFastModified());
    sun.Azimuth();
    EXPECT_FALSE(sun.IsModified());
}

TEST(VyrSun, TheDeclinationOfTheWorkedExampleIsMet) {
    // Example 25.a gives -7.78507 degrees.
    EXPECT_NEAR(declinationAt(day_of_example), -7.78507, 5e-6);
    EXPECT_NEAR(declinationAt(day_of_example), -7.785069796646783, 1e-9);
}

TEST(VyrSun, TheRightAscensionOfTheWorkedExampleIsMet) {
    // Example 25.a gives 198.38083 degrees. At the pole the azimuth is the hour angle and half a
    // turn. Sidereal time: 280.46061837 - 360.98564736629 * 2636.5 + 0.000387933 * 0.00521045 =
    // 21.801339 and 2644 turns less.
    const double azimuth = sunOfExample(90.0, 0.0).Azimuth();
    EXPECT_NEAR(21.801339 + 180.0 - azimuth, 198.38083, 6e-6);
}

TEST(VyrSun, ThePositionOfAMiddleLatitudeIsMet) {
    // theta0 = 21.80133916772961, alpha = 198.3808252121169, delta = -7.785069796646783
    const CVyrSun sun = sunOfExample(40.0, -75.0);
    EXPECT_NEAR(sun.Azimuth(), 275.9201272750338, 1e-8);
    EXPECT_NEAR(sun.Altitude(), -19.08076956142246, 1e-8);
}

TEST(VyrSun, ThePositionIsThatOfAPreciseAlgorithmWithinAHundredthOfADegree) {
    // I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications, NREL
    // 2003, table A5.1: 17 October 2003, 12:30:30, seven hours behind universal time; azimuth
    // 194.34024, altitude before refraction 39.87205.
    CVyrSun sun;
    ASSERT_TRUE(sun.SetLatitude(39.742476));
    ASSERT_TRUE(sun.SetLongitude(-105.1786));
    ASSERT_TRUE(sun.SetTimeZoneHours(-7.0));
    ASSERT_TRUE(sun.SetLocalDateTime(2003, 10, 17, 12.0 + 30.5 / 60.0));
    EXPECT_NEAR(sun.Azimuth(), 194.34024, 0.01);
    EXPECT_NEAR(sun.Altitude(), 39.87205, 0.01);
}

TEST(VyrSun, DaylightSavingAndZoneMoveTheSunAsTheClockDoes) {
    CVyrSun sun = sunOfExample(40.0, -75.0);
    const double azimuth = sun.Azimuth();
    ASSERT_TRUE(sun.SetTimeZoneHours(-5.0));
    ASSERT_TRUE(sun.SetDaylightSavingMinutes(60));
    ASSERT_TRUE(sun.SetLocalJulianDay(day_of_example - 4.0 / 24.0));
    EXPECT_NEAR(sun.Azimuth(), azimuth, 1e-6);
}

TEST(VyrSun, TheObliquityKeepsItsOwnSigns) {
    // At 2378668 and 2524593 the published signs would give 23.46736303524552 and
    // -23.0483877066044.
    EXPECT_NEAR(declinationAt(2378668.0), 23.46737234072727, 1e-9);
    EXPECT_NEAR(declinationAt(2524593.0), -23.04838107737946, 1e-9);
}

TEST(VyrSun, TheFastAltitudeTakesTheMeanLongitude) {
    // lambda = 201.8071965067073 - 0.00569 - 0.00478 * sin(264.6525821765914 degrees) =
    // 201.8062657037246; alpha = 200.1572312292026, delta = -8.497496346580805
    EXPECT_NEAR(sunOfExample(90.0, 0.0).FastAltitude(), -8.497496346580805, 1e-9);
    EXPECT_NEAR(sunOfExample(40.0, -75.0).FastAltitude(), -18.17911833288847, 1e-8);
}

TEST(VyrSun, TheFastAltitudeFollowsThePlace) {
    WatchedSun sun;
    ASSERT_TRUE(sun.SetLocalJulianDay(day_of_example));
    ASSERT_TRUE(sun.SetLatitude(40.0));
    ASSERT_TRUE(sun.SetLongitude(-75.0));
    sun.FastAltitude();
    ASSERT_TRUE(sun.SetLatitude(-33.0));
    ASSERT_TRUE(sun.SetLongitude(151.0));
    EXPECT_FALSE(sun.IsFastModified());
    EXPECT_NEAR(sun.FastAltitude(), 54.80385693958284, 1e-8);
}

TEST(VyrSun, TheFastAltitudeComputesWhatDependsOnTheDateOnceForAllPlaces) {
    // What is computed while the processor rounds up differs in its last digits from what is
    // computed as usual, and the sidereal time of some hundred million degrees has lost the digits
    // that would hide it.
    CVyrSun usual = sunOfExample(40.0, -75.0);
    CVyrSun rounded_up = usual;
    usual.FastAltitude();
    double after_usual_terms = 0.0;
    double after_rounded_terms = 0.0;
    {
        const RoundingUp rounding;
        ASSERT_TRUE(usual.SetLatitude(-33.0));
        ASSERT_TRUE(rounded_up.SetLatitude(-33.0));
        after_usual_terms = usual.FastAltitude();
        after_rounded_terms = rounded_up.FastAltitude();
    }
    EXPECT_NE(after_usual_terms, after_rounded_terms);
    EXPECT_NEAR(after_usual_terms, after_rounded_terms, 1e-5);
}

TEST(VyrSun, TheFastAltitudeFollowsTheTime) {
    CVyrSun sun = sunOfExample(90.0, 0.0);
    sun.FastAltitude();
    ASSERT_TRUE(sun.SetLocalJulianDay(2378668.0));
    EXPECT_NEAR(sun.FastAltitude(), 23.46637909129684, 1e-9);
}

TEST(VyrSun, TheAzimuthIsAlwaysWithinOneTurn) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> latitude(-90.0, 90.0);
    std::uniform_real_distribution<double> longitude(-180.0, 180.0);
    std::uniform_real_distribution<double> julian_day(2378496.5, 2524593.4);
    CVyrSun sun;
    for (int i = 0; i < 10000; ++i) {
        sun.SetLatitude(latitude(random));
        sun.SetLongitude(longitude(random));
        sun.SetLocalJulianDay(julian_day(random));
        ASSERT_GE(sun.Azimuth(), 0.0);
        ASSERT_LT(sun.Azimuth(), 360.0);
        // 1.92 degrees of longitude is the most that the equation of centre can be.
        ASSERT_NEAR(sun.FastAltitude(), sun.Altitude(), 1.93);
    }
}

TEST(VyrSun, TheLightOfAHighSunInTheSouthFallsNorthAndDown) {
    double vec[3] = {};
    CVyrSun::ConvertHorizonCoordsToSolarVector(180.0, 60.0, vec);
    EXPECT_NEAR(vec[0], 0.0, 1e-15);
    EXPECT_NEAR(vec[1], 0.5, 1e-15);
    EXPECT_NEAR(vec[2], -std::sqrt(3.0) / 2.0, 1e-15);
}

TEST(VyrSun, TheLightOfARisingSunFallsWest) {
    double vec[3] = {};
    CVyrSun::ConvertHorizonCoordsToSolarVector(90.0, 0.0, vec);
    EXPECT_NEAR(vec[0], -1.0, 1e-15);
    EXPECT_NEAR(vec[1], 0.0, 1e-15);
    EXPECT_NEAR(vec[2], 0.0, 1e-15);
}

TEST(VyrSun, TheDirectionOfTheLightGivesThePositionBack) {
    for (double altitude = -89.5; altitude < 90.0; altitude += 0.5) {
        for (double azimuth = 0.0; azimuth < 360.0; azimuth += 7.5) {
            double vec[3] = {};
            CVyrSun::ConvertHorizonCoordsToSolarVector(azimuth, altitude, vec);
            double azimuth_back = -1.0;
            double altitude_back = -1.0;
            CVyrSun::ConvertSolarVectorToHorizonCoords(vec, azimuth_back, altitude_back);
            ASSERT_NEAR(azimuth_back, azimuth, 1e-10);
            ASSERT_NEAR(altitude_back, altitude, 1e-10);
        }
    }
}

TEST(VyrSun, AnAzimuthWestOfNorthComesBackAsAPositiveOne) {
    double vec[3] = {};
    CVyrSun::ConvertHorizonCoordsToSolarVector(-30.0, 20.0, vec);
    double azimuth = 0.0;
    double altitude = 0.0;
    CVyrSun::ConvertSolarVectorToHorizonCoords(vec, azimuth, altitude);
    EXPECT_NEAR(azimuth, 330.0, 1e-12);
    EXPECT_NEAR(altitude, 20.0, 1e-12);
}

} // namespace
