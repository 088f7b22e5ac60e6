#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

constexpr int side = 240;

DisplayModeAttributes withAllEdges(const wchar_t* mode) {
    return withEdges(modeNamed(mode), MeshEdgeChoice::all);
}

struct Block {
    double mean = 0.0;
    double deviation = 0.0; ///< root of the mean square
};

/// The 40 by 40 pixels in the middle of a picture.
Block middleOf(const Image& image) {
    double sum = 0.0;
    double squares = 0.0;
    for (int y = side / 2 - 20; y < side / 2 + 20; ++y)
        for (int x = side / 2 - 20; x < side / 2 + 20; ++x) {
            const double value = brightness(image, x, y);
            sum += value;
            squares += value * value;
        }
    const double mean = sum / 1600.0;
    return {mean, std::sqrt(std::max(0.0, squares / 1600.0 - mean * mean))};
}

// 600 cells in 200 pixels: three edges of every triangle in less than a pixel.
TEST(DenseTone, EdgesThatCannotBeToldApartAreALightAndEvenTone) {
    SceneContent content;
    addMesh(content, hillMesh(600));
    for (const wchar_t* const mode : {L"Wireframe", L"Drawing"}) {
        const Image all = drawn(content, topView(60.0), withAllEdges(mode), side, side);
        const Image features = drawn(content, topView(60.0), modeNamed(mode), side, side);
        const double paper = middleOf(features).mean;
        const Block tone = middleOf(all);
        EXPECT_LT(tone.mean, paper - 15.0) << mode;
        EXPECT_GT(tone.mean, paper - 50.0) << mode;
        EXPECT_LT(tone.deviation, 2.0) << mode;
        EXPECT_EQ(brightness(all, 3, 3), brightness(features, 3, 3)) << mode; // beside the mesh
    }
}

// From 20 pixels a cell to half a pixel, each time by a fifth root of 2.
TEST(DenseTone, ComesGraduallyAsTheCameraMovesAway) {
    SceneContent content;
    addMesh(content, hillMesh(100));
    for (const wchar_t* const mode : {L"Wireframe", L"Drawing"}) {
        double before = 0.0;
        for (double half = 6.0; half < 240.0; half *= std::pow(2.0, 0.2)) {
            const double mean =
                middleOf(drawn(content, topView(half), withAllEdges(mode), side, side)).mean;
            if (before > 0.0) {
                EXPECT_NEAR(mean, before, 10.0) << mode << ' ' << half;
            }
            before = mean;
        }
    }
}

TEST(DenseTone, DoesNotFlickerWhenTheMeshTurns) {
    SceneContent content;
    addMesh(content, hillMesh(400));
    const auto frame = [&](double turned_deg) {
        const double angle = turned_deg * KM_PI / 180.0;
        const KM_3dPoint eye(120.0 * std::cos(angle), 120.0 * std::sin(angle), 110.0);
        return drawn(content, perspectiveView(eye, {0.0, 0.0, 0.0}), withAllEdges(L"Wireframe"),
                     side, side);
    };
    const Image first = frame(30.0);
    const Image second = frame(31.0);
    double change = 0.0;
    for (int y = side / 2 - 20; y < side / 2 + 20; ++y)
        for (int x = side / 2 - 20; x < side / 2 + 20; ++x)
            change += std::fabs(brightness(second, x, y) - brightness(first, x, y));
    EXPECT_LT(change / 1600.0, 2.0);
    EXPECT_LT(middleOf(first).mean, brightness(first, 1, 1) - 12.0);
}

TEST(DenseTone, IsTheSameForAnyNumberOfThreads) {
    SceneContent content;
    addMesh(content, hillMesh(300));
    const KM_Viewport viewport = perspectiveView({90.0, -70.0, 60.0}, {0.0, 0.0, 0.0});
    const auto draw = [&](std::size_t threads) {
        const tbb::global_control limit(tbb::global_control::max_allowed_parallelism, threads);
        return drawn(content, viewport, withAllEdges(L"Drawing"), side, side);
    };
    const Image alone = draw(1);
    EXPECT_EQ(draw(2).rgba, alone.rgba);
    EXPECT_EQ(draw(7).rgba, alone.rgba);
}

// A tone lies on what is seen: behind a wall there is none.
TEST(DenseTone, SurfacesHideIt) {
    SceneContent content;
    addMesh(content, hillMesh(600));
    const Image open = drawn(content, topView(60.0), withAllEdges(L"Drawing"), side, side);
    addMesh(content, floorMesh(-60.0F, -60.0F, 60.0F, 60.0F, 40.0F));
    const Image covered = drawn(content, topView(60.0), withAllEdges(L"Drawing"), side, side);
    EXPECT_LT(middleOf(open).mean, 240.0);
    EXPECT_GT(brightness(covered, side / 2 + 30, side / 2), 250.0); // off the wall's diagonal
}

} // namespace
} // namespace quarn
