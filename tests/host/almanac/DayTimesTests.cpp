#include "host/almanac/DayTimes.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

using namespace std::chrono;
using Since = WantedTime::Since;

CivilSite berlin() {
    CivilSite site{"Berlin, Germany", 52.52, 13.41};
    EXPECT_TRUE(giveZone(site, "").ok());
    return site;
}

CivilSite at60North() {
    return {"", 60, 0, 0, Zone::fixed({})};
}

FoundMoment find(const CivilSite& site, year_month_day day, std::string_view word,
                 bool is_end = false) {
    const auto wanted = wantedTime(word);
    EXPECT_TRUE(wanted) << word;
    return findTime(site, day, wanted.value_or(WantedTime()), "--from", is_end);
}

TEST(WantedTimes, AreReadAndToldAlike) {
    for (const char* const word : {"00:00", "06:05", "23:59", "sunrise", "sunset", "sunrise+1h",
                                   "sunset-1h30m", "sunset+45m", "sunrise-11h59m"}) {
        const auto time = wantedTime(word);
        ASSERT_TRUE(time) << word;
        EXPECT_EQ(wantedTimeText(*time), word);
    }
    EXPECT_EQ(wantedTime("6:05")->later, 6h + 5min);
    EXPECT_EQ(wantedTime("sunset-1h30m")->later, -90min);
    EXPECT_EQ(wantedTime("sunset-1h30m")->since, Since::sunset);
}

TEST(WantedTimes, OtherWordsAreNotRead) {
    for (const char* const word :
         {"", "24:00", "6:5", "12:60", "12:-1", "-1:00", ":30", "noon", "sunrise+", "sunrise+1",
          "sunrise1h", "sunset-30m1h", "sunset--5m", "sunrise+12h", "Sunrise", "sunset+1h5"})
        EXPECT_FALSE(wantedTime(word)) << word;
}

// 60 N 0 E on 21 June 2019, United States Naval Observatory: rise 02:36, set 21:28, to the minute.
TEST(DayTimes, FollowTheSunOfThePublishedTable) {
    const sys_days day(2019y / June / 21);
    EXPECT_LE(abs(find(at60North(), 2019y / June / 21, "sunrise+1h").time - (day + 3h + 36min)),
              1min);
    EXPECT_LE(abs(find(at60North(), 2019y / June / 21, "sunset-1h30m").time - (day + 19h + 58min)),
              1min);
}

TEST(DayTimes, ThatClocksShowTwiceAreTheOutermost) {
    const auto day = 2026y / October / 25;
    const FoundMoment first = find(berlin(), day, "02:30");
    const FoundMoment last = find(berlin(), day, "02:30", true);
    EXPECT_EQ(first.kind, FoundMoment::Kind::first_of_two);
    EXPECT_EQ(last.kind, FoundMoment::Kind::second_of_two);
    EXPECT_EQ(first.time, sys_days(day) + 30min);
    EXPECT_EQ(last.time - first.time, 1h);
    EXPECT_NE(first.note, "");
}

TEST(DayTimes, ThatAreNotThereAreToldApart) {
    using Kind = FoundMoment::Kind;
    EXPECT_EQ(find(berlin(), 2026y / March / 29, "02:30").kind, Kind::skipped);
    CivilSite samoa{"", -13.8, -171.8};
    ASSERT_TRUE(giveZone(samoa, "Pacific/Apia").ok());
    EXPECT_EQ(find(samoa, 2011y / December / 30, "12:00").kind, Kind::no_day);
    const CivilSite north{"", 80, 0, 0, Zone::fixed({})};
    EXPECT_EQ(find(north, 2026y / December / 21, "sunrise").kind, Kind::no_rise);
    EXPECT_EQ(find(north, 2026y / June / 21, "sunset").kind, Kind::no_set);
    for (const FoundMoment& none :
         {find(berlin(), 2026y / March / 29, "02:30"), find(north, 2026y / June / 21, "sunset")})
        EXPECT_NE(none.mistake, "");
}

TEST(DaylightTests, IsFromTheFirstToTheLastStepWithTheSunUp) {
    // The table has 02:36 and 21:28. There the sun climbs 15 cos 60 sin 36.5 = 4.5 degrees an hour,
    // and its centre, unlifted, is up 50 minutes of arc, or 11 of time, later.
    const sys_days day(2019y / June / 21);
    const Daylight light = daylightOf(at60North(), 2019y / June / 21, 15min);
    EXPECT_EQ(light.kind, Daylight::Kind::light);
    EXPECT_EQ(light.first, day + 3h);
    EXPECT_EQ(light.last, day + 21h + 15min);
}

TEST(DaylightTests, OfPolarDayIsTheWholeAndOfPolarNightNone) {
    const CivilSite north{"", 80, 0, 0, Zone::fixed({})};
    const Daylight day = daylightOf(north, 2026y / June / 21, 60min);
    EXPECT_EQ(day.kind, Daylight::Kind::polar_day);
    EXPECT_EQ(day.last - day.first, 23h);
    const Daylight night = daylightOf(north, 2026y / December / 21, 60min);
    EXPECT_EQ(night.kind, Daylight::Kind::no_rise);
    EXPECT_NE(night.mistake, "");
}

} // namespace
} // namespace quarn
