#include "host/sunhours/SunMoments.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

using namespace std::chrono;

WantedTime byTheClock(minutes time) {
    return {WantedTime::Since::midnight, time};
}

SunHoursRequest athensOn(year_month_day day) {
    SunHoursRequest request;
    request.site.latitude_deg = 37.98;
    request.site.longitude_deg = 23.73;
    request.site.zone = Zone::named("Europe/Athens").value();
    request.first_day = request.last_day = day;
    return request;
}

TEST(SunMomentsTests, LongestDayOfAthensLastsAsLongAsTheSunsCentreIsUp) {
    // 2 acos(-tan 37.98 tan 23.44) / 15 = 14.63 hours.
    EXPECT_NEAR(momentsOf(athensOn(2026y / June / 21)).hours, 14.63, 10.0 / 60.0);
}

TEST(SunMomentsTests, SpanThatStepsDoNotFillKeepsItsLength) {
    SunHoursRequest request = athensOn(2026y / June / 21);
    request.from = byTheClock(hours(10));
    request.to = byTheClock(hours(11) + minutes(25));
    const SunMoments found = momentsOf(request);
    EXPECT_NEAR(found.hours, 85.0 / 60.0, 1e-9);
    ASSERT_EQ(found.moments.size(), 10U); // 10:00, ..., 11:20, 11:25
    EXPECT_NEAR(found.moments.front().step.hours, 5.0 / 60.0, 1e-9);
    EXPECT_NEAR(found.moments.back().step.hours, 2.5 / 60.0, 1e-9);
    EXPECT_EQ(request.site.zone.at(found.moments.front().time).local,
              local_days(2026y / June / 21) + hours(10));
}

/// From 01:00 to 05:00 by the clock of Berlin, where the sun does not set.
double hoursAroundTheChange(double latitude_deg, year_month_day day) {
    SunHoursRequest request = athensOn(day);
    request.site.latitude_deg = latitude_deg;
    request.site.zone = Zone::named("Europe/Berlin").value();
    request.from = byTheClock(hours(1));
    request.to = byTheClock(hours(5));
    return momentsOf(request).hours;
}

TEST(SunMomentsTests, HourThatClocksSkipIsMissingAndTheOneTheyShowTwiceCountsTwice) {
    EXPECT_NEAR(hoursAroundTheChange(89, 2026y / March / 28), 4.0, 1e-9);
    EXPECT_NEAR(hoursAroundTheChange(89, 2026y / March / 29), 3.0, 1e-9);
    EXPECT_NEAR(hoursAroundTheChange(-89, 2026y / October / 25), 5.0, 1e-9);
}

TEST(SunMomentsTests, PolarNightHasNoMoments) {
    SunHoursRequest request = athensOn(2026y / December / 21);
    request.site.latitude_deg = 80;
    EXPECT_TRUE(momentsOf(request).moments.empty());
    EXPECT_EQ(momentsOf(request).hours, 0.0);
}

TEST(SunMomentsTests, HoursOfSeveralDaysAreTheirMean) {
    SunHoursRequest request = athensOn(2026y / March / 1);
    request.last_day = 2026y / March / 22;
    request.every_days = 7;
    request.from = byTheClock(hours(10));
    request.to = byTheClock(hours(12));
    const SunMoments found = momentsOf(request);
    EXPECT_EQ(found.days, 4);
    EXPECT_NEAR(found.hours, 2.0, 1e-9);
}

TEST(SunMomentsTests, NorthTurnsTheSunClockwise) {
    SunHoursRequest request = athensOn(2026y / March / 21);
    request.from = byTheClock(hours(12));
    request.to = byTheClock(hours(13)); // the sun is in the south at half past twelve
    const KM_3dVector plain = momentsOf(request).moments[3].step.toward;
    EXPECT_NEAR(plain.x, 0.0, 0.05);
    EXPECT_LT(plain.y, -0.5);
    request.site.north_deg = 90; // along X: south is against it
    const KM_3dVector turned = momentsOf(request).moments[3].step.toward;
    EXPECT_NEAR(turned.x, plain.y, 1e-9);
    EXPECT_NEAR(turned.y, -plain.x, 1e-9);
}

// Days of all seasons, each without its first and its last hour of sun; the bare horizon is a few
// minutes later than that of the tables.
TEST(SunMomentsTests, TimesOfTheSunAreEachDaysOwn) {
    SunHoursRequest request = athensOn(2026y / March / 21);
    request.last_day = 2026y / December / 31;
    request.every_days = 91;
    const double whole = momentsOf(request).hours;
    request.from = wantedTime("sunrise+1h");
    request.to = wantedTime("sunset-1h");
    EXPECT_NEAR(momentsOf(request).hours, whole - 2.0, 0.25);
}

TEST(SunMomentsTests, DaysWithoutASunriseAreTakenWhole) {
    SunHoursRequest request = athensOn(2026y / June / 21);
    request.site.latitude_deg = 80;
    request.from = wantedTime("sunrise+1h");
    EXPECT_NEAR(momentsOf(request).hours, 24.0, 1e-9);
}

TEST(SunMomentsTests, EndBeforeTheBeginningHasNone) {
    SunHoursRequest request = athensOn(2026y / December / 21);
    request.from = wantedTime("sunrise+6h");
    request.to = byTheClock(hours(9));
    EXPECT_TRUE(momentsOf(request).moments.empty());
}

} // namespace
} // namespace quarn
