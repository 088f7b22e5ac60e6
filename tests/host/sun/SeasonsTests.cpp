#include "host/sun/Seasons.h"
#include "host/sun/SunYears.h"
#include "tests/host/sun/SunInstants.h"

#include <gtest/gtest.h>

#include <cmath>
#include <ostream>

namespace quarn {
namespace {

/// United States Naval Observatory, "Earth's Seasons": universal time, to the minute.
struct PublishedYear {
    int year;
    const char* march;
    const char* june;
    const char* september;
    const char* december;

    friend void PrintTo(const PublishedYear& year, std::ostream* out) { *out << year.year; }
};

constexpr PublishedYear PUBLISHED[] = {
    {2000, "2000-03-20 07:35", "2000-06-21 01:48", "2000-09-22 17:28", "2000-12-21 13:37"},
    {2010, "2010-03-20 17:32", "2010-06-21 11:28", "2010-09-23 03:09", "2010-12-21 23:38"},
    {2020, "2020-03-20 03:50", "2020-06-20 21:44", "2020-09-22 13:31", "2020-12-21 10:02"},
    {2024, "2024-03-20 03:06", "2024-06-20 20:51", "2024-09-22 12:44", "2024-12-21 09:21"},
    {2025, "2025-03-20 09:01", "2025-06-21 02:42", "2025-09-22 18:19", "2025-12-21 15:03"},
};

class PublishedSeasons : public testing::TestWithParam<PublishedYear> {};

TEST_P(PublishedSeasons, AreFoundWithinAMinute) {
    const PublishedYear& year = GetParam();
    const Seasons found = seasonsOf(year.year);
    const auto expectNear = [](std::chrono::sys_seconds time, const char* published) {
        EXPECT_NEAR(static_cast<double>((time - utc(published)).count()), 0, 60) << published;
    };
    expectNear(found.march_equinox, year.march);
    expectNear(found.june_solstice, year.june);
    expectNear(found.september_equinox, year.september);
    expectNear(found.december_solstice, year.december);
}

INSTANTIATE_TEST_SUITE_P(Years, PublishedSeasons, testing::ValuesIn(PUBLISHED));

// Jean Meeus, Astronomical Algorithms, 2nd edition, example 27.a: the solstice of June 1962 at
// 21:24:42 terrestrial time by his short series, which is good to a minute.
TEST(Seasons, HaveTheSolsticeOfTheWorkedExample) {
    EXPECT_NEAR(
        static_cast<double>((seasonsOf(1962).june_solstice - utc("1962-06-21 21:24:42")).count()) +
            69.2,
        0, 60);
}

/// Table 27.B of the same book, a polynomial for the mean solstice of June, which the true one
/// leaves by less than half an hour: holds the far ends of the years.
TEST(Seasons, StayWithTheMeanSolsticeInAllYears) {
    for (int year = FIRST_SUN_YEAR; year <= LAST_SUN_YEAR; year += 7) {
        const double y = (year - 2000) / 1000.0;
        const double julian_day =
            2451716.56767 + 365241.62603 * y + 0.00325 * y * y + 0.00888 * y * y * y;
        const double found =
            2440587.5 +
            static_cast<double>(seasonsOf(year).june_solstice.time_since_epoch().count()) / 86400.0;
        EXPECT_NEAR(found, julian_day, 0.5 / 24) << year;
    }
}

} // namespace
} // namespace quarn
