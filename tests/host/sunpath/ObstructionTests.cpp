#include "host/sunpath/Obstruction.h"
#include "tests/engine/display/DisplayFixture.h"
#include "tests/host/sunpath/SvgShapes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <random>

namespace quarn {
namespace {

using testing::IsEmpty;
using testing::SizeIs;

constexpr double RADIANS_PER_DEGREE = std::numbers::pi / 180;

/// A wall 10 north of the origin, from 50 west to 50 east, 5 high and 1 thick.
SceneContent wall() {
    SceneContent content;
    content.revision = 1;
    addMesh(content, boxMesh({-50, 10, 0}, {50, 11, 5}));
    return content;
}

Obstruction seen(const SceneContent& content, const SkyWatch& watch) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content));
    return obstructionAround(scene, watch);
}

/// How high the wall stands from a height of 1.5: over the distance 10 / cos(azimuth) it is 3.5
/// higher. Nothing where it has ended.
double wallAltitude(double azimuth_deg) {
    const double azimuth = std::remainder(azimuth_deg, 360) * RADIANS_PER_DEGREE;
    if (std::abs(azimuth) >= std::atan(5.0))
        return 0;
    return std::atan(3.5 / 10 * std::cos(azimuth)) / RADIANS_PER_DEGREE;
}

TEST(Obstruction, OfAWallIsAsHighAsTheWall) {
    const Obstruction obstruction = seen(wall(), {{0, 0, 1.5}, 0, {}});
    ASSERT_GE(obstruction.lines.size(), 720u);
    for (std::size_t line = 0; line < obstruction.lines.size(); ++line) {
        const double azimuth_deg = obstruction.azimuthOf(line);
        const double side_deg = std::abs(std::remainder(azimuth_deg, 360));
        if (std::abs(side_deg - 78.69) < 1) // its end, a little thick
            continue;
        const double altitude_deg = wallAltitude(azimuth_deg);
        if (altitude_deg == 0) {
            EXPECT_THAT(obstruction.lines[line], IsEmpty()) << azimuth_deg;
            continue;
        }
        ASSERT_THAT(obstruction.lines[line], SizeIs(1)) << azimuth_deg;
        EXPECT_EQ(obstruction.lines[line][0].low_deg, 0);
        EXPECT_NEAR(obstruction.lines[line][0].high_deg, altitude_deg, 0.011) << azimuth_deg;
    }
}

// North 30 degrees clockwise from the Y axis: the wall across the Y axis stands 30 degrees west of
// north.
TEST(Obstruction, TurnsWithNorth) {
    const Obstruction obstruction = seen(wall(), {{0, 0, 1.5}, 30, {}});
    for (const std::size_t line : {0u, 120u, 1200u, 1320u}) {
        const double azimuth_deg = obstruction.azimuthOf(line);
        const auto& bands = obstruction.lines[line];
        ASSERT_THAT(bands, SizeIs(1)) << azimuth_deg;
        EXPECT_NEAR(bands[0].high_deg, wallAltitude(azimuth_deg + 30), 0.011) << azimuth_deg;
    }
}

TEST(Obstruction, UnderARoofLeavesTheHorizonFree) {
    SceneContent content;
    content.revision = 1;
    addMesh(content, floorMesh(-3, -3, 3, 3, 4));
    const Obstruction obstruction = seen(content, {{0, 0, 1}, 0, {}});
    for (const std::size_t line : {std::size_t{0}, obstruction.lines.size() / 4}) {
        ASSERT_THAT(obstruction.lines[line], SizeIs(1));
        // Its border is 3 away, but for the eighth of a degree beside north or east, and 3 higher.
        EXPECT_NEAR(obstruction.lines[line][0].low_deg, 45, 0.011);
        EXPECT_EQ(obstruction.lines[line][0].high_deg, 90);
    }
}

/// How high the walls stand toward the north; 0 where they hide nothing.
double heightInNorth(const SceneContent& content, const std::optional<std::size_t>& absent = {}) {
    const auto bands = seen(content, {{0, 0, 1.5}, 0, absent}).lines[0];
    return bands.empty() ? 0 : bands[0].high_deg;
}

/// A wall with another one behind it, which is twice as far away.
SceneContent wallWithOneBehind() {
    SceneContent content = wall();
    addMesh(content, boxMesh({-50, 20, 0}, {50, 21, 5}));
    return content;
}

const double FIRST_WALL_DEG = std::atan(3.5 / 10) / RADIANS_PER_DEGREE;
const double SECOND_WALL_DEG = std::atan(3.5 / 20) / RADIANS_PER_DEGREE;

TEST(Obstruction, LeavesOutTheMeshThatIsAbsent) {
    EXPECT_NEAR(heightInNorth(wallWithOneBehind()), FIRST_WALL_DEG, 0.011);
    EXPECT_NEAR(heightInNorth(wallWithOneBehind(), 0), SECOND_WALL_DEG, 0.011);
    EXPECT_EQ(heightInNorth(wall(), 0), 0);
}

TEST(Obstruction, GlassHidesNothingAsItShadesNothing) {
    const auto heightBehind = [](const Material& material) {
        SceneContent content = wallWithOneBehind();
        content.meshes[0].placed.material = std::make_shared<const Material>(material);
        return heightInNorth(content);
    };
    Material glass;
    glass.transmission = 0.9F;
    EXPECT_NEAR(heightBehind(glass), SECOND_WALL_DEG, 0.011);
    glass.transmission = 0.4F;
    EXPECT_NEAR(heightBehind(glass), FIRST_WALL_DEG, 0.011);
    Material pane;
    pane.see_through = true;
    pane.base_color.a = 100;
    EXPECT_NEAR(heightBehind(pane), SECOND_WALL_DEG, 0.011);
    pane.base_color.a = 150;
    EXPECT_NEAR(heightBehind(pane), FIRST_WALL_DEG, 0.011);
}

/// Directions in the areas are hidden, others are not; those within half a degree of a border may
/// be on either side of it.
TEST(HiddenAreas, HoldTheDirectionsThatAreHidden) {
    SceneContent content = wall();
    addMesh(content, floorMesh(-3, -3, 3, 3, 8));
    const SkyDisk disk{SkyProjection::stereographic, {500, 500}, 400};
    SvgLines areas;
    for (const auto& area : hiddenAreas(seen(content, {{0, 0, 1.5}, 0, {}}), disk)) {
        areas.emplace_back();
        for (const DrawnPoint& point : area)
            areas.back().push_back({point.x_px, point.y_px});
    }
    const auto isHidden = [](double azimuth_deg, double altitude_deg) {
        if (altitude_deg < wallAltitude(azimuth_deg))
            return true;
        // Where the ray is 6.5 higher than it began.
        const double away = 6.5 / std::tan(altitude_deg * RADIANS_PER_DEGREE);
        return std::abs(away * std::sin(azimuth_deg * RADIANS_PER_DEGREE)) < 3 &&
               std::abs(away * std::cos(azimuth_deg * RADIANS_PER_DEGREE)) < 3;
    };
    std::mt19937 chance(4);
    std::uniform_real_distribution<double> azimuths(0, 360);
    std::uniform_real_distribution<double> altitudes(0.6, 89);
    int hidden = 0;
    for (int round = 0; round < 4000; ++round) {
        const double azimuth_deg = azimuths(chance);
        const double altitude_deg = altitudes(chance);
        const bool is_hidden = isHidden(azimuth_deg, altitude_deg);
        bool is_at_border = false;
        for (const double turn_deg : {-1.0, 1.0})
            for (const double lift_deg : {-0.5, 0.5})
                is_at_border |=
                    isHidden(azimuth_deg + turn_deg, altitude_deg + lift_deg) != is_hidden;
        if (is_at_border)
            continue;
        const DrawnPoint place = disk.at({azimuth_deg, altitude_deg});
        EXPECT_EQ(isInside(areas, {place.x_px, place.y_px}), is_hidden)
            << azimuth_deg << " " << altitude_deg;
        hidden += is_hidden;
    }
    EXPECT_GT(hidden, 400);
}

} // namespace
} // namespace quarn
