#include "host/clock/Zone.h"
#include "host/clock/ZoneDatabase.h"
#include "host/clock/ZoneOffset.h"
#include "tests/host/clock/CLibraryClock.h"

#include <gtest/gtest.h>

namespace {

using namespace quarn;
using namespace std::chrono;

sys_seconds utc(year_month_day date, int hour, int minute = 0) {
    return sys_days(date) + hours(hour) + minutes(minute);
}

local_seconds local(year_month_day date, int hour, int minute = 0) {
    return local_days(date) + hours(hour) + minutes(minute);
}

Zone zone(const char* name) {
    auto found = Zone::named(name);
    EXPECT_TRUE(found.ok()) << found.message();
    return found ? found.value() : Zone::fixed(0min);
}

void expectAsTheCLibrary(const std::string& name, const WallTime& wall, const std::tm& shown) {
    const auto day = floor<days>(wall.local);
    const year_month_day date{day};
    const hh_mm_ss time(wall.local - day);
    EXPECT_EQ(wall.offset.count(), shown.tm_gmtoff) << name;
    EXPECT_EQ(wall.abbreviation, letteredName(shown.tm_zone, wall.offset)) << name;
    EXPECT_EQ(int(date.year()), shown.tm_year + 1900) << name;
    EXPECT_EQ(unsigned(date.month()), unsigned(shown.tm_mon) + 1U) << name;
    EXPECT_EQ(unsigned(date.day()), unsigned(shown.tm_mday)) << name;
    EXPECT_EQ(time.hours().count(), shown.tm_hour) << name;
    EXPECT_EQ(time.minutes().count(), shown.tm_min) << name;
    EXPECT_EQ(time.seconds().count(), shown.tm_sec) << name;
}

/// A moment at which the clocks of a zone were, or will be, put forward or back.
struct Change {
    const char* zone;
    sys_seconds moment;
};

const Change CHANGES[] = {
    {"Europe/Berlin", utc(2026y / 3 / 29, 1)},
    {"Europe/Berlin", utc(2026y / 10 / 25, 1)},
    {"Europe/Berlin", utc(1916y / 4 / 30, 22)}, // the first summer time of a country
    {"Europe/London", utc(1941y / 5 / 4, 1)},   // to two hours of it
    {"Europe/Dublin", utc(2026y / 10 / 25, 1)},
    {"America/New_York", utc(2026y / 3 / 8, 7)},
    {"America/New_York", utc(2026y / 11 / 1, 6)},
    {"America/St_Johns", utc(2026y / 3 / 8, 5, 30)}, // half an hour from the others
    {"America/St_Johns", utc(2026y / 11 / 1, 4, 30)},
    {"Australia/Sydney", utc(2026y / 4 / 4, 16)},
    {"Australia/Sydney", utc(2026y / 10 / 3, 16)},
    {"Australia/Adelaide", utc(2026y / 4 / 4, 16, 30)},
    {"Australia/Adelaide", utc(2026y / 10 / 3, 16, 30)},
    {"Australia/Lord_Howe", utc(2026y / 4 / 4, 15)}, // by half an hour
    {"Australia/Lord_Howe", utc(2026y / 10 / 3, 15, 30)},
    {"Pacific/Chatham", utc(2026y / 4 / 4, 14)}, // 12:45 ahead
    {"Pacific/Auckland", utc(2026y / 9 / 26, 14)},
    {"America/Santiago", utc(2026y / 4 / 5, 3)},
    {"America/Sao_Paulo", utc(2018y / 11 / 4, 3)},    // at midnight
    {"Asia/Kathmandu", utc(1985y / 12 / 31, 18, 30)}, // from 5:30 to 5:45
    {"Asia/Kolkata", utc(1945y / 10 / 14, 17, 30)},
    {"Pacific/Apia", utc(2011y / 12 / 30, 10)}, // over the date line
    {"America/Caracas", utc(2016y / 5 / 1, 7)}, // zones that places changed for good
    {"Asia/Pyongyang", utc(2015y / 8 / 14, 15)},
    {"Europe/Moscow", utc(2014y / 10 / 25, 22)},
    {"Africa/Casablanca", utc(2026y / 2 / 15, 2)}, // back for Ramadan
    {"Europe/Berlin", utc(2040y / 3 / 25, 1)},
    {"Europe/Berlin", utc(2040y / 10 / 28, 1)},
    {"Europe/Dublin", utc(2040y / 3 / 25, 1)},
    {"America/New_York", utc(2040y / 3 / 11, 7)},
    {"America/Nuuk", utc(2040y / 3 / 25, 1)}, // a rule with a time before midnight
    {"Asia/Gaza", utc(2040y / 10 / 27, 0)},   // and one with a time two days later
    {"Australia/Sydney", utc(2040y / 3 / 31, 16)},
    {"Australia/Sydney", utc(2040y / 10 / 6, 16)},
    {"America/Santiago", utc(2040y / 4 / 8, 3)},
    {"Pacific/Chatham", utc(2040y / 9 / 29, 14)},
};

TEST(Zone, ShowsWhatTheCLibraryShowsAroundChangesOfTheClocks) {
    for (const auto& [name, moment] : CHANGES) {
        const Zone there = zone(name);
        const CLibraryClock c_library(name);
        EXPECT_NE(c_library.at(moment - 1s).tm_gmtoff, c_library.at(moment).tm_gmtoff)
            << name << " changes nothing then";
        expectAsTheCLibrary(name, there.at(moment - 1s), c_library.at(moment - 1s));
        expectAsTheCLibrary(name, there.at(moment), c_library.at(moment));
    }
}

TEST(Zone, ReadsBackTheMomentsAroundChangesOfTheClocks) {
    for (const auto& [name, moment] : CHANGES) {
        const Zone there = zone(name);
        for (const sys_seconds time : {moment - 25h, moment - 1s, moment, moment + 25h}) {
            const WallReading reading = there.read(there.at(time).local);
            ASSERT_NE(reading.kind, WallReading::Kind::skipped) << name;
            EXPECT_TRUE(reading.first == time || reading.second == time) << name;
        }
    }
}

TEST(Zone, TellsAnHourThatIsSkippedAndWhenTheClocksWereChanged) {
    const WallReading berlin = zone("Europe/Berlin").read(local(2026y / 3 / 29, 2, 30));
    EXPECT_EQ(berlin.kind, WallReading::Kind::skipped);
    EXPECT_EQ(berlin.first, utc(2026y / 3 / 29, 1));
    const WallReading later = zone("Australia/Sydney").read(local(2040y / 10 / 7, 2, 0));
    EXPECT_EQ(later.kind, WallReading::Kind::skipped);
    EXPECT_EQ(later.first, utc(2040y / 10 / 6, 16));
    const WallReading day = zone("Pacific/Apia").read(local(2011y / 12 / 30, 12));
    EXPECT_EQ(day.kind, WallReading::Kind::skipped);
    EXPECT_EQ(day.first, utc(2011y / 12 / 30, 10));
}

TEST(Zone, TellsBothMomentsOfAnHourThatComesTwice) {
    const WallReading berlin = zone("Europe/Berlin").read(local(2026y / 10 / 25, 2, 30));
    EXPECT_EQ(berlin.kind, WallReading::Kind::twice);
    EXPECT_EQ(berlin.first, utc(2026y / 10 / 25, 0, 30));
    EXPECT_EQ(berlin.second, utc(2026y / 10 / 25, 1, 30));
    const WallReading half = zone("Australia/Lord_Howe").read(local(2026y / 4 / 5, 1, 45));
    EXPECT_EQ(half.kind, WallReading::Kind::twice);
    EXPECT_EQ(half.second - half.first, 30min);
    const WallReading later = zone("Europe/Berlin").read(local(2040y / 10 / 28, 2, 0));
    EXPECT_EQ(later.kind, WallReading::Kind::twice);
}

TEST(Zone, BordersOfSkippedAndRepeatedHoursBelongToOneSide) {
    const Zone berlin = zone("Europe/Berlin");
    EXPECT_EQ(berlin.read(local(2026y / 3 / 29, 3, 0)).first, utc(2026y / 3 / 29, 1));
    EXPECT_EQ(berlin.read(local(2026y / 3 / 29, 2, 0)).kind, WallReading::Kind::skipped);
    EXPECT_EQ(berlin.read(local(2026y / 10 / 25, 3, 0)).kind, WallReading::Kind::unique);
    EXPECT_EQ(berlin.read(local(2026y / 10 / 25, 2, 0)).kind, WallReading::Kind::twice);
}

TEST(Zone, CallsSummerTimeWhatIsAheadOfTheRestOfTheYear) {
    const sys_seconds june = utc(2026y / 6 / 21, 12);
    const sys_seconds december = utc(2026y / 12 / 21, 12);
    for (const char* const name : {"Europe/Berlin", "Europe/Dublin", "America/New_York"}) {
        EXPECT_TRUE(zone(name).at(june).is_summer_time) << name;
        EXPECT_FALSE(zone(name).at(december).is_summer_time) << name;
    }
    EXPECT_FALSE(zone("Australia/Sydney").at(june).is_summer_time);
    EXPECT_TRUE(zone("Australia/Sydney").at(december).is_summer_time);
    EXPECT_FALSE(zone("Africa/Casablanca").at(june).is_summer_time);
    EXPECT_FALSE(zone("Africa/Casablanca").at(utc(2026y / 3 / 1, 12)).is_summer_time);
    EXPECT_FALSE(zone("Asia/Kolkata").at(june).is_summer_time);
}

TEST(Zone, StandardOffsetIsThatOfWinterOnBothHemispheres) {
    EXPECT_EQ(zone("Europe/Berlin").standardOffset(2026), 1h);
    EXPECT_EQ(zone("Europe/Dublin").standardOffset(2026), 0h);
    EXPECT_EQ(zone("Australia/Sydney").standardOffset(2040), 10h);
    EXPECT_EQ(zone("America/St_Johns").standardOffset(2026), -(3h + 30min));
}

TEST(Zone, IsAskedForInHoursFromUtcToo) {
    EXPECT_EQ(zone("+05:30").at(sys_seconds{}).offset, 5h + 30min);
    EXPECT_EQ(zone("+05:30").name(), "UTC+5:30");
    EXPECT_EQ(zone("UTC+5:30").at(sys_seconds{}).abbreviation, "UTC+5:30");
    EXPECT_EQ(zone("-3").at(sys_seconds{}).offset, -3h);
    EXPECT_EQ(zone("UTC").at(sys_seconds{}).offset, 0h);
    for (const char* const wrong : {"", "+", "+5:", "+5:60", "+25", "+1:2:3", "5", "UTC5", "+ 5"})
        EXPECT_FALSE(Zone::named(wrong).ok()) << wrong;
}

TEST(Zone, OfTheSunIsFourMinutesADegree) {
    const auto solar = Zone::written("solar", 13.41);
    ASSERT_TRUE(solar.ok());
    EXPECT_EQ(solar.value().at(sys_seconds{}).offset, 53min + 38s); // 13.41 * 240 s = 3218.4 s
    EXPECT_EQ(Zone::solar(-74.01).at(sys_seconds{}).offset, -(4h + 56min + 2s));
    EXPECT_EQ(solar.value().at(sys_seconds{}).abbreviation, "LMT");
    EXPECT_FALSE(Zone::named("solar").ok());
}

TEST(Zone, IsFoundWhateverTheCaseOfItsName) {
    EXPECT_EQ(zone("europe/berlin").name(), "Europe/Berlin");
    EXPECT_EQ(zone("America/New York").name(), "America/New_York");
    EXPECT_EQ(zone("etc/gmt+5").name(), "Etc/GMT+5");
}

TEST(Zone, ThatDoesNotExistIsRefusedWithNamesLikeIt) {
    const auto mistyped = Zone::named("Europe/Berlni");
    ASSERT_FALSE(mistyped.ok());
    EXPECT_NE(mistyped.message().find("\"Europe/Berlni\" is no time zone."), std::string::npos);
    EXPECT_NE(mistyped.message().find("Did you mean Europe/Berlin?"), std::string::npos);
    EXPECT_NE(Zone::named("Kolkata").message().find("Asia/Kolkata"), std::string::npos);
    EXPECT_EQ(Zone::named("Mordor/Barad-dur").message().find("Did you mean"), std::string::npos);
    EXPECT_FALSE(Zone::named("../../../etc/passwd").ok());
}

TEST(Zone, WithoutTheDatabaseIsRefusedWithThePackageToInstall) {
    const auto missing = databaseZone("Europe/Berlin", "/nowhere/zoneinfo");
    ASSERT_FALSE(missing.ok());
    EXPECT_NE(missing.message().find("package tzdata"), std::string::npos);
}

} // namespace
