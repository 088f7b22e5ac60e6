#include "bench/SteadyTurntable.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <cstddef>

namespace quarn {
namespace {

constexpr int width = 320;
constexpr int height = 180;
constexpr int frame_count = 6;

const bench::Orbit around_the_yard{{0.0, 0.0, 1.5}, 26.0, 24.0, 250.0, 50.0};

/// A box, a ball and a fence of bars that are little wider than a pixel, on a floor.
SceneContent yard() {
    SceneContent content;
    addMesh(content, floorMesh(-8, -8, 8, 8, 0.0F), {150, 140, 120, 255});
    addMesh(content, boxMesh({-4, -2, 0}, {-1, 1, 4}), {190, 60, 40, 255});
    addMesh(content, sphereMesh({3, 1, 2}, 2.0F, 24), {235, 235, 225, 255});
    for (int i = -6; i <= 6; ++i)
        addMesh(content, boxMesh({i - 0.09, -5.09, 0}, {i + 0.09, -4.91, 2}), {70, 60, 50, 255});
    content.lights.push_back(sunLight({0.8, 0.4, -0.5}));
    return content;
}

bench::SteadyTurntable::Comparison compared(const SceneContent& content, const wchar_t* mode) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    bench::SteadyTurntable turntable(scene, around_the_yard, width, height);
    const auto comparison = turntable.compare(modeNamed(mode), frame_count);
    EXPECT_TRUE(comparison.ok());
    return comparison.value();
}

class SteadyEdges : public testing::TestWithParam<const wchar_t*> {};

TEST_P(SteadyEdges, CrawlLessInATurntableWithEachLevelOfSmoothing) {
    const auto comparison = compared(yard(), GetParam());
    const auto& crawl = comparison.residual;
    ASSERT_GT(crawl[0].count(), 3U * 1000U * (frame_count - 1));
    EXPECT_LT(crawl[2].mean(), crawl[1].mean());
    EXPECT_LT(crawl[1].mean(), crawl[0].mean());
    // What is left of it with 64 rays a pixel comes from comparing, not from the edges.
    const double rest = crawl[bench::SteadyTurntable::reference].mean();
    EXPECT_LT(crawl[2].mean() - rest, 0.5 * (crawl[0].mean() - rest));
}

TEST_P(SteadyEdges, ComeNearerTo64RaysAPixelWithEachLevelOfSmoothing) {
    const auto error = compared(yard(), GetParam()).error;
    ASSERT_GT(error[0].count(), 3U * 1000U * frame_count);
    EXPECT_LT(error[2].rootMeanSquare(), error[1].rootMeanSquare());
    EXPECT_LT(error[1].rootMeanSquare(), error[0].rootMeanSquare());
}

INSTANTIATE_TEST_SUITE_P(Modes, SteadyEdges, testing::Values(L"Shaded", L"Rendered"),
                         [](const auto& mode) {
                             return mode.param[0] == L'S' ? "Shaded" : "Rendered";
                         });

/// A frame of a small box before a large one, and what is known of it.
struct Seen {
    Image image;
    bench::FrameShape shape;
};

Seen seen(const SceneContent& content, const KM_Viewport& viewport) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    Seen frame;
    frame.shape.rays = cameraRays(viewport, width, height, scene.boundingBox());
    frame.image = drawn(content, viewport, modeNamed(L"Shaded"), width, height, &frame.shape.depth);
    frame.shape.edges = bench::findEdges(frame.image, frame.shape.depth);
    return frame;
}

/// A camera 100 above the ground, which sees 9 units of it up and down from the middle.
KM_Viewport fromAbove() {
    KM_Viewport viewport = topView(9.0);
    viewport.SetProjection(KM_perspective_view);
    viewport.SetFrustum(-0.09, 0.09, -0.09, 0.09, 1.0, 1000.0);
    return viewport;
}

TEST(EdgeSteadiness, FindsNothingWhereTheCameraStandsStill) {
    const Seen frame = seen(yard(), around_the_yard.at(0.0));
    const auto carried = bench::FrameCarrier(frame.shape, frame.shape).carryEdges();
    ASSERT_GT(carried.size(), 1000U);
    bench::ColorDifference residual;
    bench::addResidual(carried, frame.image, frame.image, residual);
    EXPECT_LT(residual.mean(), 0.05); // a ray's place in single precision
}

TEST(EdgeSteadiness, CarriesAnEdgeAsFarAsTheCameraMoves) {
    // Half of the picture's height, 90 pixels, is 9 units: 10 pixels a unit.
    SceneContent content;
    addMesh(content, floorMesh(-2, -2, 2, 2, 0.0F));
    KM_Viewport viewport = fromAbove();
    const Seen frame = seen(content, viewport);
    viewport.SetCameraLocation({1.2, -0.5, 100.0});
    const Seen next = seen(content, viewport);
    const auto carried = bench::FrameCarrier(frame.shape, next.shape).carryEdges();
    // The square is 40 by 40 pixels; along its edge lie pixels on either side, no corners outside.
    EXPECT_EQ(carried.size(), 4U * 40U + (40U * 40U - 38U * 38U));
    for (const bench::CarriedPixel& pixel : carried) {
        EXPECT_NEAR(pixel.next_x, static_cast<float>(pixel.x) + 0.5F - 12.0F, 1e-3F);
        EXPECT_NEAR(pixel.next_y, static_cast<float>(pixel.y) + 0.5F - 5.0F, 1e-3F);
    }
}

TEST(EdgeSteadiness, LeavesOutWhatIsHiddenInTheNextFrame) {
    SceneContent content;
    addMesh(content, floorMesh(-2, -2, 2, 2, 0.0F));
    const Seen frame = seen(content, fromAbove());
    SceneContent covered = content;
    addMesh(covered, floorMesh(-4, -4, 4, 4, 50.0F));
    const Seen next = seen(covered, fromAbove());
    EXPECT_TRUE(bench::FrameCarrier(frame.shape, next.shape).carryEdges().empty());
}

} // namespace
} // namespace quarn
