#include "host/sun/SunEvents.h"
#include "tests/host/sun/OtherSun.h"
#include "tests/host/sun/SunInstants.h"

#include <gtest/gtest.h>

#include <cmath>
#include <ostream>
#include <random>

namespace quarn {
namespace {

using Kind = SunEvent::Kind;
using Course = SunEvents::Course;
using namespace std::chrono_literals;

constexpr auto DAY = std::chrono::hours(24);

double secondsBetween(std::chrono::sys_seconds one, std::chrono::sys_seconds other) {
    return static_cast<double>((one - other).count());
}

/// United States Naval Observatory, "Sunrise/Sunset/Moonrise/Moonset for one year" (2019): the
/// first rise and set of a day of universal time at sea level, to the minute.
struct PublishedDay {
    double latitude_deg;
    double longitude_deg;
    const char* date;
    const char* rise;
    const char* set;

    friend void PrintTo(const PublishedDay& day, std::ostream* out) {
        *out << day.latitude_deg << " " << day.longitude_deg << " " << day.date;
    }
};

constexpr PublishedDay PUBLISHED[] = {
    {-60, -150, "2019-01-15", "13:12", "07:07"}, {-60, -150, "2019-03-20", "16:00", "04:16"},
    {-60, -150, "2019-05-15", "18:13", "01:41"}, {-60, -150, "2019-06-21", "19:06", "00:58"},
    {-60, -150, "2019-08-25", "17:11", "02:52"}, {-60, -150, "2019-09-23", "15:45", "03:59"},
    {-60, -150, "2019-10-15", "14:38", "04:52"}, {-60, -150, "2019-12-21", "12:32", "07:24"},
    {29, -81, "2019-01-15", "12:19", "22:48"},   {29, -81, "2019-03-20", "11:28", "23:35"},
    {29, -81, "2019-05-15", "10:33", "00:08"},   {29, -81, "2019-06-21", "10:26", "00:26"},
    {29, -81, "2019-08-25", "10:58", "23:54"},   {29, -81, "2019-09-23", "11:13", "23:20"},
    {29, -81, "2019-10-15", "11:25", "22:54"},   {29, -81, "2019-12-21", "12:13", "22:31"},
    {60, 0, "2019-01-15", "08:48", "15:31"},     {60, 0, "2019-03-20", "06:03", "18:14"},
    {60, 0, "2019-05-15", "03:23", "20:31"},     {60, 0, "2019-06-21", "02:36", "21:28"},
    {60, 0, "2019-08-25", "04:37", "19:25"},     {60, 0, "2019-09-23", "05:46", "17:58"},
    {60, 0, "2019-10-15", "06:38", "16:52"},     {60, 0, "2019-12-21", "09:02", "14:54"},
};

class PublishedSunEvents : public testing::TestWithParam<PublishedDay> {};

TEST_P(PublishedSunEvents, AreFoundWithinAMinute) {
    const PublishedDay& day = GetParam();
    const std::string date = day.date;
    const SunEvents found =
        sunEvents({day.latitude_deg, day.longitude_deg}, utc(date), utc(date) + DAY);
    ASSERT_TRUE(found.first(Kind::rise));
    ASSERT_TRUE(found.first(Kind::set));
    EXPECT_LE(std::abs(secondsBetween(*found.first(Kind::rise), utc(date + " " + day.rise))), 60);
    EXPECT_LE(std::abs(secondsBetween(*found.first(Kind::set), utc(date + " " + day.set))), 60);
}

INSTANTIATE_TEST_SUITE_P(Places, PublishedSunEvents, testing::ValuesIn(PUBLISHED));

// The parallax of 8.8 seconds of arc brings the sun nearest the horizon down by that much.
constexpr double PARALLAX_DEG = 8.8 / 3600;

TEST(SunEvents, AreWhereAnotherTheoryHasTheSunAtTheHorizonAndInTheMeridian) {
    constexpr double TEN_SECONDS_OF_ARC = 10.0 / 3600;
    const SunSite site{39.742476, -105.1786};
    for (const char* const date : {"2003-10-17", "1850-02-03", "2150-06-30"}) {
        const SunEvents found = sunEvents(site, utc(date), utc(date) + DAY);
        ASSERT_EQ(found.events.size(), 3u) << date;
        for (const SunEvent& event : found.events) {
            const OtherSun sun(event.time);
            if (event.kind == Kind::transit)
                EXPECT_NEAR(sun.hourAngle(site.longitude_deg), 0, TEN_SECONDS_OF_ARC) << date;
            else
                EXPECT_NEAR(sun.altitude(site) - PARALLAX_DEG, PUBLISHED_HORIZON_DEG,
                            TEN_SECONDS_OF_ARC)
                    << date;
        }
    }
}

TEST(SunEvents, DayLengthIsTheTimeFromRiseToSet) {
    const SunEvents found = sunEvents({60, 0}, utc("2019-06-21"), utc("2019-06-21") + DAY);
    EXPECT_EQ(found.course, Course::rises_or_sets);
    EXPECT_EQ(found.day_length, *found.first(Kind::set) - *found.first(Kind::rise));
    EXPECT_NEAR(static_cast<double>(found.day_length.count()), (18 * 60 + 52) * 60, 120);
}

TEST(SunEvents, DayLengthOfADayThatBeginsInSunshineCountsItsBothParts) {
    const SunEvents found = sunEvents({-60, -150}, utc("2019-01-15"), utc("2019-01-15") + DAY);
    const auto night = *found.first(Kind::rise) - *found.first(Kind::set);
    EXPECT_GT(night, 0s);
    EXPECT_EQ(found.day_length, DAY - night);
}

// 16 + 34 minutes of arc at the equator at an equinox, where the sun climbs 15 degrees an hour: the
// day is 2 x 50/60 / 15 hours = 6 min 40 s longer.
TEST(SunEvents, BareHorizonLeavesOutRefractionAndTheHalfDiameter) {
    const auto day = utc("2019-03-20");
    const SunEvents published = sunEvents({0, 0}, day, day + DAY);
    const SunEvents bare = sunEvents({0, 0}, day, day + DAY, BARE_HORIZON_DEG);
    EXPECT_NEAR(static_cast<double>((published.day_length - bare.day_length).count()), 400, 3);
    EXPECT_NEAR(static_cast<double>(bare.day_length.count()), 12 * 3600, 30);
}

// At noon of the winter solstice the sun stands 90 - 67.39 - 23.436 = -0.826 degrees high, less the
// parallax 0.0024: 0.005 above the horizon of the tables. It comes within cos(latitude)
// cos(declination) (hour angle)^2 / 2 of that: some 4 minutes on either side.
TEST(SunEvents, ShortestDaysAreNotMissed) {
    const auto day = utc("2019-12-21");
    for (const double longitude : {0.0, 3.0, 100.0, -179.0, 180.0}) {
        const SunEvents found = sunEvents({67.39, longitude}, day, day + DAY);
        const SunEvents dark = sunEvents({67.41, longitude}, day, day + DAY);
        EXPECT_EQ(found.course, Course::rises_or_sets) << longitude;
        EXPECT_GT(found.day_length, 2min) << longitude;
        EXPECT_LT(found.day_length, 20min) << longitude;
        EXPECT_EQ(dark.course, Course::polar_night) << longitude;
        EXPECT_EQ(dark.day_length, 0s) << longitude;
    }
}

TEST(SunEvents, DayLengthIsTheCountOfMinutesWithTheSunUp) {
    std::mt19937 chance(20);
    std::uniform_real_distribution<double> latitude(64, 70);
    std::uniform_real_distribution<double> longitude(-180, 180);
    for (int round = 0; round < 6; ++round) {
        const SunSite site{round % 2 ? latitude(chance) : -latitude(chance), longitude(chance)};
        const auto day = utc("2024-05-10") + DAY * (40 * round);
        int minutes = 0;
        for (auto time = day; time < day + DAY; time += 1min)
            minutes += sunPosition(site, time).altitude_deg >= PUBLISHED_HORIZON_DEG;
        const SunEvents found = sunEvents(site, day, day + DAY);
        EXPECT_NEAR(static_cast<double>(found.day_length.count()) / 60, minutes, 2.1)
            << site.latitude_deg << " " << round;
    }
}

TEST(SunEvents, SunOfTheNorthPoleRisesOnceAndSetsOnceAYear) {
    const SunEvents found = sunEvents({90, 0}, utc("2022-01-01"), utc("2023-01-01"));
    std::vector<SunEvent> crossings = found.events;
    std::erase_if(crossings, [](const SunEvent& e) { return e.kind == Kind::transit; });
    ASSERT_EQ(crossings.size(), 2u);
    EXPECT_EQ(crossings[0].kind, Kind::rise);
    EXPECT_EQ(crossings[1].kind, Kind::set);
    // At the pole the altitude is the declination, less the parallax of 8.8 seconds.
    for (const SunEvent& event : crossings)
        EXPECT_NEAR(OtherSun(event.time).altitude({90, 0}) - PARALLAX_DEG, PUBLISHED_HORIZON_DEG,
                    0.003);
    EXPECT_EQ(found.day_length, crossings[1].time - crossings[0].time);
}

TEST(SunEvents, PolarPlacesHaveMonthsOfDayAndOfNight) {
    const auto june = utc("2022-06-21");
    const auto december = utc("2022-12-21");
    for (const SunSite& north : {SunSite{89, 30}, SunSite{90, 0}}) {
        EXPECT_EQ(sunEvents(north, june, june + DAY).course, Course::polar_day);
        EXPECT_EQ(sunEvents(north, june, june + DAY).day_length, DAY);
        EXPECT_EQ(sunEvents(north, december, december + DAY).course, Course::polar_night);
        EXPECT_EQ(sunEvents(north, december, december + DAY).day_length, 0s);
    }
    const SunSite south{-88, 45};
    EXPECT_EQ(sunEvents(south, june, june + DAY).course, Course::polar_night);
    EXPECT_EQ(sunEvents(south, december, december + DAY).course, Course::polar_day);
}

TEST(SunEvents, SunNearThePolesRisesAndSetsByTurnsAtTheHorizon) {
    for (const SunSite& site : {SunSite{89, 30}, SunSite{-88, 45}}) {
        for (const char* const equinox : {"2022-03-20", "2022-09-23"}) {
            const SunEvents found =
                sunEvents(site, utc(equinox) - 15 * DAY, utc(equinox) + 15 * DAY);
            std::vector<SunEvent> crossings = found.events;
            std::erase_if(crossings, [](const SunEvent& e) { return e.kind == Kind::transit; });
            // A degree or two from the pole the sun goes up and down by twice that in a day, and
            // climbs or sinks by 0.4 degrees: there are some days that have both.
            ASSERT_GE(crossings.size(), 7u);
            // From polar night to polar day or back, one more of one kind.
            EXPECT_EQ(crossings.size() % 2, 1u);
            for (std::size_t i = 0; i < crossings.size(); ++i) {
                EXPECT_NEAR(OtherSun(crossings[i].time).altitude(site) - PARALLAX_DEG,
                            PUBLISHED_HORIZON_DEG, 0.003);
                if (i > 0) {
                    EXPECT_NE(crossings[i].kind, crossings[i - 1].kind);
                }
            }
        }
    }
}

TEST(SunEvents, EmptySpanHasNone) {
    const SunEvents found = sunEvents({60, 0}, utc("2019-06-21"), utc("2019-06-21"));
    EXPECT_TRUE(found.events.empty());
    EXPECT_EQ(found.day_length, 0s);
}

} // namespace
} // namespace quarn
