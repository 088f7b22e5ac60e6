#include "tests/engine/render/RenderFixture.h"

#include <cmath>
#include <numbers>
#include <vector>

namespace quarn {
namespace {

constexpr double size_px = 200.0;

/// How bright the columns of a floor are across the shadow's border of a roof 400 units above it.
/// The sun stands in the west, 45 degrees high, so the roof's eastern edge, at x = -400, throws the
/// border to x = 0. 200 pixels show the 20 units around it.
std::vector<double> acrossBorder(double sun_share) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    addMesh(content, floorMesh(-900.0F, -300.0F, -400.0F, 300.0F, 400.0F));
    KM_Light sun = sunLight({1.0, 0.0, -1.0});
    sun.SetShadowIntensity(sun_share);
    content.lights = {sun};
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    const int samples = 256;
    const SampleSequence sequence(samples);
    const RenderKernel& kernel = renderKernelInForce();
    const int side = static_cast<int>(size_px);
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, topView(10.0), side, side, sequence, kernel, tables);
    RenderLayers layers(side, side);
    kernel.render_block(setup, {0, 80, side, 120}, 0, samples, layers.sums());
    std::vector<double> columns;
    for (int x = 0; x < side; ++x) {
        double sum = 0.0;
        for (int y = 80; y < 120; ++y)
            sum += double{layers.at(RenderPlane::sun_g, x, y)} / samples;
        columns.push_back(sum / 40.0);
    }
    return columns;
}

/// Where the brightness passes a share of its highest, in pixels.
double crossing(const std::vector<double>& columns, double share) {
    const double wanted = share * columns.back();
    for (std::size_t x = 1; x < columns.size(); ++x)
        if (columns[x] >= wanted)
            return static_cast<double>(x) - (columns[x] - wanted) / (columns[x] - columns[x - 1]);
    return -1.0;
}

TEST(SoftSun, PenumbraIsAsWideAsHalfADegreeMakesIt) {
    const std::vector<double> columns = acrossBorder(1.0);
    EXPECT_NEAR(columns.front(), 0.0, 1e-6) << "full shadow";
    // Rays that graze the edge run 400 sqrt(2) units at 45 degrees: an angle of 0.53 degrees
    // between them covers 2 * 400 * tan(0.53 degrees) of the floor, ten pixels to a unit.
    const double whole = 10.0 * 2.0 * 400.0 * std::tan(0.53 * std::numbers::pi / 180.0);
    // A straight border that hides all of a disc but the segment beyond t radii leaves
    // (acos t - t sqrt(1 - t^2)) / pi of it: a quarter at t = 0.404, half at 0.
    EXPECT_NEAR(crossing(columns, 0.75) - crossing(columns, 0.25), 0.404 * whole, 0.02 * whole);
    EXPECT_NEAR(crossing(columns, 0.995) - crossing(columns, 0.005), 0.95 * whole, 0.05 * whole);
    EXPECT_NEAR(crossing(columns, 0.5), 100.0, 1.0) << "the border itself stays where it was";
}

TEST(SoftSun, ShadowTakesAwayAsMuchAsTheLightSays) {
    const std::vector<double> columns = acrossBorder(0.5);
    EXPECT_NEAR(columns.front() / columns.back(), 0.5, 1e-3);
}

TEST(SoftSun, FloorThatTouchesTheEdgeHasASharpBorder) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    addMesh(content, boxMesh({-5.0, -30.0, 0.0}, {0.0, 30.0, 0.5}));
    content.lights = {sunLight({1.0, 0.0, -1.0})};
    const Image image = rendered(content, topView(2.0), {200, 200, 32});
    // The shadow ends at 0.5: column 125, with a penumbra of half a pixel.
    EXPECT_LT(brightness(image, 122, 100), 0.85 * brightness(image, 128, 100));
}

} // namespace
} // namespace quarn
