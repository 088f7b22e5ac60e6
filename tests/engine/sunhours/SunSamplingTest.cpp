#include "engine/display/InstructionSet.h"
#include "engine/sunhours/ObjectPoints.h"
#include "engine/sunhours/SurfaceGrid.h"
#include "tests/engine/sunhours/SunHoursFixture.h"

#include <tbb/task_arena.h>

namespace quarn {
namespace {

constexpr int SIDE_PX = 203;

/// Hills, a sphere, and a box that stands turned and mirrored between them.
SceneContent garden() {
    SceneContent content;
    addMesh(content, hillMesh(40));
    addMesh(content, sphereMesh({0.0, 0.0, 12.0}, 6.0F, 20));
    addMesh(content, boxMesh({-2, -2, 0}, {2, 2, 12}));
    KM_Xform mirror;
    mirror.m_xform[0][0] = -1.0;
    content.meshes[2].placed.world_from_mesh =
        KM_Xform::Translation(14, 6, 2) *
        KM_Xform::Rotation(0.4, KM_3dVector::ZAxis, KM_3dPoint::Origin) * mirror;
    return content;
}

std::vector<float> hoursOfPicture(const DisplayScene& scene) {
    const PicturePoints seen =
        pointsSeen(scene, topView(40), SIDE_PX, SIDE_PX, PixelTiles(SIDE_PX, SIDE_PX).places());
    return sunOn(scene, seen.points, sunOfDay(50, 0, 20)).hours;
}

std::vector<float> gardenBy(int threads) {
    std::vector<float> hours;
    tbb::task_arena(threads).execute([&] {
        DisplayScene scene;
        ASSERT_TRUE(scene.update(garden()).ok());
        hours = hoursOfPicture(scene);
    });
    return hours;
}

TEST(SunSamplingTest, AnyNumberOfThreadsGivesTheSameHours) {
    const std::vector<float> alone = gardenBy(1);
    EXPECT_EQ(alone, gardenBy(2));
    EXPECT_EQ(alone, gardenBy(3));
}

TEST(SunSamplingTest, InstructionSetsDifferAtNoMoreThanAFewShadowBorders) {
    const std::vector<float> fastest = gardenBy(1);
    for (const InstructionSet set : setsOfProcessor()) {
        chooseInstructionSet(set);
        const std::vector<float> hours = gardenBy(1);
        chooseInstructionSet(std::nullopt);
        ASSERT_EQ(hours.size(), fastest.size());
        std::size_t others = 0;
        for (std::size_t i = 0; i < hours.size(); ++i)
            others += hours[i] != fastest[i];
        EXPECT_LE(others, hours.size() / 500) << nameOf(set);
    }
}

TEST(SunSamplingTest, HoursAreTheStepsAtWhichAPointIsLit) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(garden()).ok());
    const PicturePoints seen = pointsSeen(scene, topView(40), 40, 40, PixelTiles(40, 40).places());
    const std::vector<SunStep> steps = sunOfDay(50, 0, 20);
    const SunLight light = sunOn(scene, seen.points, steps);
    for (std::size_t i = 0; i < seen.points.size(); ++i) {
        double hours = 0.0;
        for (std::size_t step = 0; step < steps.size(); ++step)
            hours += light.isLit(step, i) ? steps[step].hours : 0.0;
        ASSERT_NEAR(light.hours[i], hours, 1e-4) << i;
    }
}

TEST(SunSamplingTest, WatchEndsTheWork) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(garden()).ok());
    const PicturePoints seen =
        pointsSeen(scene, topView(40), SIDE_PX, SIDE_PX, PixelTiles(SIDE_PX, SIDE_PX).places());
    SunLight light;
    int calls = 0;
    EXPECT_FALSE(findSun(
        scene, seen.points, sunOfDay(50, 0, 20), false, [&](double) { return ++calls < 3; },
        light));
    EXPECT_EQ(calls, 3);
}

TEST(SunSamplingTest, EmptySceneShowsNothing) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update({}).ok());
    const PicturePlace middle{1, 1};
    const PicturePoints seen = pointsSeen(scene, topView(4), 2, 2, {&middle, 1});
    EXPECT_EQ(seen.object[0], 0U);
    EXPECT_EQ(sunOn(scene, seen.points, sunOfDay(50, 0, 20)).hours[0], 0.0F);
}

struct Mean {
    double hours = 0.0;
    double weight = 0.0;
};

double triangleArea(const KM_3fPoint* corner) {
    const auto point = [](const KM_3fPoint& p) { return KM_3dPoint(p.x, p.y, p.z); };
    return 0.5 *
           KM_CrossProduct(point(corner[1]) - point(corner[0]), point(corner[2]) - point(corner[0]))
               .Length();
}

/// Of one object alone by a fine grid, with the others around: its triangles come where it comes.
Mean meanByGrid(const SurfaceGrid& grid, const SunLight& light, std::size_t first,
                std::size_t end) {
    Mean mean;
    for (std::size_t i = first; i < end; ++i) {
        const double area = triangleArea(&grid.corners[3 * i]);
        mean.hours += area * light.hours[i];
        mean.weight += area;
    }
    return mean;
}

TEST(SunSamplingTest, MeansOfObjectsAreWithinOnePercentOfAFineGrid) {
    DisplayScene scene;
    SceneContent content = garden();
    ASSERT_TRUE(scene.update(content).ok());
    const std::vector<SunStep> steps = sunOfDay(50, 0, 20);
    const ObjectPoints spread = spreadPoints(scene);
    const SunLight light = sunOn(scene, spread.points, steps);
    ASSERT_EQ(spread.objects.size(), 3U);
    const auto grid = gridOfSurfaces(scene, 0.4);
    ASSERT_TRUE(grid.ok()) << grid.message();
    const SunLight fine = sunOn(scene, grid.value().points, steps);
    std::size_t first = 0;
    for (const ObjectSpan& object : spread.objects) {
        std::size_t end = first;
        for (double area = 0.0; end < fine.hours.size() && area < 0.99999 * object.area; ++end)
            area += triangleArea(&grid.value().corners[3 * end]);
        const Mean mean = meanByGrid(grid.value(), fine, first, end);
        EXPECT_NEAR(mean.weight, object.area, 1e-3 * object.area);
        double sum = 0.0;
        for (std::size_t i = 0; i < object.count; ++i)
            sum += light.hours[object.first + i];
        EXPECT_NEAR(sum / static_cast<double>(object.count), mean.hours / mean.weight,
                    0.01 * mean.hours / mean.weight)
            << object.mesh;
        first = end;
    }
}

TEST(SunSamplingTest, SheetsThatAreSeenFromBothSidesCountTheSunOnEither) {
    SceneContent content;
    addMesh(content, wallMesh({0, -5, 0}, {0, 5, 0}, 4)); // east in the morning, west thereafter
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const ObjectPoints both = spreadPoints(scene);
    EXPECT_NEAR(sunOn(scene, both.points, sunOfDay(0, 0, 20)).hours[0], 12.0, 0.34);
    auto one_sided = std::make_shared<Material>();
    one_sided->is_one_sided = true;
    content.meshes[0].placed.material = one_sided;
    content.revision = 7;
    ASSERT_TRUE(scene.update(content).ok());
    const ObjectPoints front = spreadPoints(scene);
    EXPECT_NEAR(sunOn(scene, front.points, sunOfDay(0, 0, 20)).hours[0], 6.0, 0.34);
}

TEST(SunSamplingTest, GridsTooFineAreRefused) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(garden()).ok());
    EXPECT_FALSE(gridOfSurfaces(scene, 0.001).ok());
}

} // namespace
} // namespace quarn
