#include "desktop/dialogs/Coastlines.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn::desktop {
namespace {

bool isLand(double latitude_deg, double longitude_deg) {
    return coastlines().contains(QPointF(longitude_deg, -latitude_deg));
}

TEST(Coastlines, ContinentsAreLand) {
    EXPECT_TRUE(isLand(48.1, 11.6));   // Munich
    EXPECT_TRUE(isLand(39.7, -105.0)); // Denver
    EXPECT_TRUE(isLand(-15.8, -47.9)); // Brasilia
    EXPECT_TRUE(isLand(0.3, 25.0));    // the Congo
    EXPECT_TRUE(isLand(-25.3, 131.0)); // Uluru
    EXPECT_TRUE(isLand(72.0, -40.0));  // Greenland
}

TEST(Coastlines, SeasAndTheCaspianAreWater) {
    EXPECT_FALSE(isLand(30, -45));
    EXPECT_FALSE(isLand(0, -140));
    EXPECT_FALSE(isLand(35, 18));   // the Mediterranean
    EXPECT_FALSE(isLand(42, 50.5)); // the Caspian
    EXPECT_FALSE(isLand(88, 0));    // the Arctic Ocean
}

TEST(Coastlines, LandGoesOnOverThe180thMeridian) {
    EXPECT_TRUE(isLand(67, 179.5)); // Chukotka, on both sides
    EXPECT_TRUE(isLand(67, -179.5));
    for (const double longitude : {179.9, -179.9}) {
        EXPECT_FALSE(isLand(0, longitude));
        EXPECT_FALSE(isLand(45, longitude));
    }
}

TEST(Coastlines, AntarcticaReachesThePoleAtEveryLongitude) {
    for (int longitude = -179; longitude < 180; longitude += 7)
        EXPECT_TRUE(isLand(-89, longitude)) << longitude;
    EXPECT_TRUE(isLand(-75, 100));
    EXPECT_FALSE(isLand(-60, 100));
}

TEST(Coastlines, StayOnTheMapAndNoLineRunsAcrossIt) {
    ASSERT_GT(coastlines().elementCount(), 5000);
    QPointF last;
    for (int index = 0; index < coastlines().elementCount(); ++index) {
        const QPainterPath::Element point = coastlines().elementAt(index);
        EXPECT_LE(std::abs(point.x), 180.0);
        EXPECT_LE(std::abs(point.y), 90.0);
        const bool is_at_the_edge = std::abs(point.y) > 89.9 || std::abs(last.y()) > 89.9 ||
                                    (std::abs(point.x) > 179.9 && std::abs(last.x()) > 179.9);
        if (!point.isMoveTo() && !is_at_the_edge) {
            EXPECT_LT(std::hypot(point.x - last.x(), point.y - last.y()), 15.0) << index;
        }
        last = point;
    }
}

TEST(Coastlines, ReadStepsFromTheFirstPointOn) {
    const QPainterPath land = coastlinesFromText("2\n-2 4 4 0 0 -4 -4 0\n");
    EXPECT_EQ(land.boundingRect(), QRectF(-1, -2, 2, 2)); // latitudes 2 to 0, y down
    EXPECT_TRUE(land.contains(QPointF(0, -1)));
}

TEST(Coastlines, RingWithinARingIsALakeWhicheverWayItRuns) {
    for (const char* lake : {"-1 1 2 0 0 -2 -2 0", "-1 1 0 -2 2 0 0 2"}) {
        const QPainterPath land = coastlinesFromText("1\n-2 2 4 0 0 -4 -4 0\n" + QByteArray(lake));
        EXPECT_FALSE(land.contains(QPointF(0, 0))) << lake;
        EXPECT_TRUE(land.contains(QPointF(1.5, 0))) << lake;
    }
}

TEST(Coastlines, TakeNoHarmFromAFileThatIsNone) {
    for (const char* text :
         {"", "0\n1 2 3 4 5 6\n", "x\n1 2 3 4 5 6\n", "50\n\n1 2 3\n1 2 a b 3 4\n"})
        EXPECT_TRUE(coastlinesFromText(text).isEmpty()) << text;
}

} // namespace
} // namespace quarn::desktop
