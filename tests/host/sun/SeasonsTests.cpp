#include "host/sun/Seasons.h"
#include "host/sun/SunYears.h"
#include "tests/host/sun/OtherSun.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn {
namespace {

/// The sun goes a degree a day: ten seconds of arc are four minutes.
void expectLongitude(std::chrono::sys_seconds time, double longitude_deg) {
    constexpr double TEN_SECONDS_OF_ARC = 10.0 / 3600;
    EXPECT_NEAR(std::remainder(OtherSun(time).longitude_deg - longitude_deg, 360), 0,
                TEN_SECONDS_OF_ARC)
        << longitude_deg;
}

TEST(Seasons, BeginWhereAnotherTheoryHasTheSunAtRightAnglesInAllYears) {
    for (int year = FIRST_SUN_YEAR; year <= LAST_SUN_YEAR; year += 19) {
        SCOPED_TRACE(year);
        const Seasons found = seasonsOf(year);
        expectLongitude(found.march_equinox, 0);
        expectLongitude(found.june_solstice, 90);
        expectLongitude(found.september_equinox, 180);
        expectLongitude(found.december_solstice, 270);
    }
}

TEST(Seasons, AreThoseOfTheYear) {
    using namespace std::chrono;
    for (const int year : {FIRST_SUN_YEAR, 2026, LAST_SUN_YEAR}) {
        const Seasons found = seasonsOf(year);
        const auto monthOf = [&](sys_seconds time) {
            const year_month_day day{floor<days>(time)};
            EXPECT_EQ(int(day.year()), year);
            return unsigned(day.month());
        };
        EXPECT_EQ(monthOf(found.march_equinox), 3U);
        EXPECT_EQ(monthOf(found.june_solstice), 6U);
        EXPECT_EQ(monthOf(found.september_equinox), 9U);
        EXPECT_EQ(monthOf(found.december_solstice), 12U);
    }
}

} // namespace
} // namespace quarn
