#include "sdk/zel/QnZone.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

// By hand: the clock gains an hour in every 15 degrees eastward.
TEST(Zone, IsTheWholeHoursOfALongitudeCountedFromGreenwich) {
    EXPECT_EQ(QnZoneOfLongitude(0.0), 0);
    EXPECT_EQ(QnZoneOfLongitude(14.99), 0);
    EXPECT_EQ(QnZoneOfLongitude(15.0), 1);
    EXPECT_EQ(QnZoneOfLongitude(-14.99), 0);
    EXPECT_EQ(QnZoneOfLongitude(-15.0), -1);
    EXPECT_EQ(QnZoneOfLongitude(-105.18), -7);
    EXPECT_EQ(QnZoneOfLongitude(180.0), 12);
    EXPECT_EQ(QnZoneOfLongitude(254.82), 16);
    EXPECT_EQ(QnZoneOfLongitude(360.0), 24);
    EXPECT_EQ(QnZoneOfLongitude(-360.0), -24);
}

TEST(Zone, OfWhatIsNoLongitudeIsThatOfGreenwich) {
    for (const double longitude : {360.5, -361.0, 1e300, -HUGE_VAL, std::nan("")})
        EXPECT_EQ(QnZoneOfLongitude(longitude), 0) << longitude;
}

TEST(Zone, IsToldByItsDistanceToUniversalTime) {
    EXPECT_EQ(QnZoneText(0).ToUtf8(), "UTC");
    EXPECT_EQ(QnZoneText(60).ToUtf8(), "UTC+1");
    EXPECT_EQ(QnZoneText(-7 * 60).ToUtf8(), "UTC-7");
    EXPECT_EQ(QnZoneText(330).ToUtf8(), "UTC+5:30");
    EXPECT_EQ(QnZoneText(-210).ToUtf8(), "UTC-3:30");
    EXPECT_EQ(QnZoneText(-5).ToUtf8(), "UTC-0:05");
}

} // namespace
