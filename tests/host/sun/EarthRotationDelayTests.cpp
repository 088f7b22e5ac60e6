#include "host/sun/EarthRotationDelay.h"

#include <gtest/gtest.h>

namespace {

using quarn::earthRotationDelay_s;

// F. Espenak and J. Meeus, Five Millennium Canon of Solar Eclipses (NASA/TP-2006-214141), table 2:
// values from observations, to a tenth of a second.
TEST(EarthRotationDelay, IsWhatWasObserved) {
    EXPECT_NEAR(earthRotationDelay_s(1955), 31.1, 0.2);
    EXPECT_NEAR(earthRotationDelay_s(1960), 33.2, 0.2);
    EXPECT_NEAR(earthRotationDelay_s(1970), 40.2, 0.2);
    EXPECT_NEAR(earthRotationDelay_s(1980), 50.5, 0.2);
    EXPECT_NEAR(earthRotationDelay_s(1990), 56.9, 0.2);
    EXPECT_NEAR(earthRotationDelay_s(2000), 63.8, 0.2);
}

// The expressions were fitted one by one; the table's neighbours agree to about a second.
TEST(EarthRotationDelay, HasNoLeapWhereOneExpressionFollowsAnother) {
    for (const double year : {1860, 1900, 1920, 1941, 1961, 1986, 2005, 2050, 2150})
        EXPECT_NEAR(earthRotationDelay_s(year - 1e-6), earthRotationDelay_s(year), 1) << year;
}

// -20 + 32 ((2199 - 1820) / 100)^2
TEST(EarthRotationDelay, FollowsTheLongTermParabolaFrom2150) {
    EXPECT_NEAR(earthRotationDelay_s(2199), 439.6512, 1e-9);
}

} // namespace
