// What the sun reaches, held against shadow geometry that is worked out beside each test.
#include "tests/engine/sunhours/SunHoursFixture.h"

namespace quarn {
namespace {

constexpr double OBLIQUITY_DEG = 23.44;
constexpr double STEP_HOURS = 10.0 / 60.0;

KM_Viewport fromAbove() {
    return topView(2.0);
}

SceneContent floorAlone() {
    SceneContent content;
    addMesh(content, floorMesh(-50, -50, 50, 50, 0));
    return content;
}

TEST(SunGeometryTest, OpenFloorGetsTheLengthOfTheDay) {
    // Half the day arc: cos H = -tan 50 tan 23.44 = -0.51672, H = 121.113 degrees of 15 an hour.
    const double day_length = 2.0 * 121.113 / 15.0;
    EXPECT_NEAR(hoursInMiddle(floorAlone(), fromAbove(), sunOfDay(50, OBLIQUITY_DEG, 10)),
                day_length, STEP_HOURS);
    EXPECT_NEAR(hoursInMiddle(floorAlone(), fromAbove(), sunOfDay(50, -OBLIQUITY_DEG, 10)),
                24.0 - day_length, STEP_HOURS);
}

TEST(SunGeometryTest, PolarNightGivesNothingAndThePolarDayAllHours) {
    EXPECT_EQ(hoursInMiddle(floorAlone(), fromAbove(), sunOfDay(80, -OBLIQUITY_DEG, 10)), 0.0);
    EXPECT_NEAR(hoursInMiddle(floorAlone(), fromAbove(), sunOfDay(80, OBLIQUITY_DEG, 10)), 24.0,
                1e-4);
}

TEST(SunGeometryTest, WallsGetTheSunOfTheirOrientation) {
    // At 40 degrees north on the longest day the sun stands due east and west at
    // cos H = tan 23.44 / tan 40 = 0.51671, H = 58.887 degrees, and sets at H = 111.340.
    const std::vector<SunStep> steps = sunOfDay(40, OBLIQUITY_DEG, 10);
    SceneContent content;
    addMesh(content, wallMesh({-5, 0, 0}, {5, 0, 0}, 4));
    const KM_3dPoint middle(0.0, 0.0, 2.0);
    EXPECT_NEAR(hoursInMiddle(content, perspectiveView({0, -9, 2}, middle), steps),
                2.0 * 58.887 / 15.0, STEP_HOURS);
    EXPECT_NEAR(hoursInMiddle(content, perspectiveView({0, 9, 2}, middle), steps),
                2.0 * (111.340 - 58.887) / 15.0, STEP_HOURS);
    SceneContent across;
    addMesh(across, wallMesh({0, -5, 0}, {0, 5, 0}, 4));
    EXPECT_NEAR(hoursInMiddle(across, perspectiveView({9, 0, 2}, middle), steps), 111.340 / 15.0,
                STEP_HOURS);
}

TEST(SunGeometryTest, PointBehindAWallGetsSunOnceItStandsHigherThanTheWall) {
    // On the equator at the equinox the sun goes up in the east by 15 degrees an hour, through the
    // zenith. A long wall in the east, 3 away and 3 high, hides it up to 45 degrees: for 3 hours.
    SceneContent content = floorAlone();
    addMesh(content, wallMesh({3, -50, 0}, {3, 50, 0}, 3));
    EXPECT_NEAR(hoursInMiddle(content, fromAbove(), sunOfDay(0, 0, 10)), 9.0, STEP_HOURS);
}

TEST(SunGeometryTest, SideThatTurnsAwayFromTheSunGetsNone) {
    SceneContent content;
    addMesh(content, floorMesh(-50, -50, 50, 50, 10));
    EXPECT_EQ(hoursInMiddle(content, perspectiveView({0, -1, 1}, {0, 0, 10}), sunOfDay(0, 0, 10)),
              0.0);
}

/// A floor under a pane of a material, so wide that no sun comes in below it.
SceneContent underPane(const Material& material) {
    SceneContent content = floorAlone();
    addMesh(content, floorMesh(-1000, -1000, 1000, 1000, 5));
    content.meshes[1].placed.material = std::make_shared<const Material>(material);
    return content;
}

/// Of the floor, seen from the middle between floor and pane.
double hoursUnder(const Material& material) {
    return hoursInMiddle(underPane(material), perspectiveView({0, -1, 2}, {0, 0, 0}),
                         sunOfDay(0, 0, 10));
}

TEST(SunGeometryTest, PanesShadeFromHalfTheirOpacityOn) {
    Material pane;
    pane.see_through = true;
    pane.base_color.a = 100;
    EXPECT_NEAR(hoursUnder(pane), 12.0, STEP_HOURS);
    pane.base_color.a = 150;
    EXPECT_EQ(hoursUnder(pane), 0.0);
}

TEST(SunGeometryTest, GlassThatTransmitsMoreThanHalfShadesNothing) {
    Material glass;
    glass.transmission = 0.9F;
    EXPECT_NEAR(hoursUnder(glass), 12.0, STEP_HOURS);
    glass.transmission = 0.4F;
    EXPECT_EQ(hoursUnder(glass), 0.0);
}

TEST(SunGeometryTest, PictureLooksThroughGlass) {
    Material glass;
    glass.transmission = 0.9F;
    DisplayScene scene;
    ASSERT_TRUE(scene.update(underPane(glass)).ok());
    const PicturePlace middle{32.5F, 32.5F};
    EXPECT_EQ(pointsSeen(scene, fromAbove(), 64, 64, {&middle, 1}).object[0], 1U);
    glass.transmission = 0.4F;
    DisplayScene shaded;
    ASSERT_TRUE(shaded.update(underPane(glass)).ok());
    EXPECT_EQ(pointsSeen(shaded, fromAbove(), 64, 64, {&middle, 1}).object[0], 2U);
}

} // namespace
} // namespace quarn
