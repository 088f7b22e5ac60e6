#include "host/almanac/WantedDay.h"

#include "host/sun/Seasons.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

using namespace std::chrono;

year_month_day read(std::string_view word, const Zone& zone) {
    const auto wanted = wantedDay(word);
    EXPECT_TRUE(wanted) << word;
    return dayOf(wanted.value_or(WantedDay()), zone);
}

TEST(WantedDayTests, NamedDayIsThatOfTheClocksOfThePlace) {
    const auto solstice = seasonsOf(2030).june_solstice;
    for (const int hours_east : {-12, 0, 14}) {
        const Zone zone = Zone::fixed(hours(hours_east));
        EXPECT_EQ(read("solstice-june-2030", zone),
                  year_month_day(floor<days>(solstice + hours(hours_east))));
    }
    EXPECT_NE(read("solstice-june-2030", Zone::fixed(hours(-12))),
              read("solstice-june-2030", Zone::fixed(hours(14))));
}

TEST(WantedDayTests, NamedDayWithoutAYearIsOfThisOne) {
    const Zone zone = Zone::fixed({});
    const auto before = today(zone);
    const auto found = read("equinox-march", zone);
    if (today(zone).year() != before.year())
        GTEST_SKIP() << "a year ended";
    EXPECT_EQ(found, read("equinox-march-" + std::to_string(int(before.year())), zone));
}

TEST(WantedDayTests, EachNameIsAnotherDay) {
    const Zone zone = Zone::fixed({});
    EXPECT_EQ(read("equinox-march-2026", zone).month(), March);
    EXPECT_EQ(read("solstice-june-2026", zone).month(), June);
    EXPECT_EQ(read("equinox-september-2026", zone).month(), September);
    EXPECT_EQ(read("solstice-december-2026", zone).month(), December);
    EXPECT_EQ(read("2026-03-21", zone), 2026y / March / 21);
}

TEST(WantedDayTests, OtherWordsAreNotRead) {
    for (const char* const word :
         {"", "tomorrow", "solstice", "solstice-june-", "solstice-june-30", "solstice-june-02030",
          "solstice-june-203x", "solstice-june2030", "Solstice-June", "2026-6-21", "+026-06-21",
          "2026-06-2x", "20260621", "2026-06-021"})
        EXPECT_FALSE(wantedDay(word)) << word;
}

TEST(WantedDayTests, DateThatNoCalendarHasIsReadAsSuch) {
    ASSERT_TRUE(isoDate("2026-04-31"));
    EXPECT_FALSE(isoDate("2026-04-31")->ok());
}

} // namespace
} // namespace quarn
