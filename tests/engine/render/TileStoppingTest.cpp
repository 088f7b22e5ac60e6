#include "engine/render/TileStopping.h"

#include "engine/render/SampleTaking.h"
#include "tests/engine/render/RenderFixture.h"

#include <algorithm>

namespace quarn {
namespace {

constexpr int width_px = 160;
constexpr int height_px = 96;

SceneContent tower() {
    SceneContent content;
    addMesh(content, floorMesh(-300.0F, -300.0F, 300.0F, 300.0F, 0.0F));
    addMesh(content, boxMesh({-5.0, -5.0, 0.0}, {5.0, 5.0, 12.0}), {200, 80, 60, 255});
    content.lights = {sunLight({1.0, 0.5, -0.8})};
    return content;
}

/// Takes samples of the tower as the renderer does.
RenderLayers sampled(int samples) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(tower()).ok());
    const SampleSequence sequence(samples);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, topView(25.0), width_px, height_px, sequence, kernel, tables);
    RenderLayers layers(width_px, height_px);
    SampleTaking taking(setup, kernel, layers, samples);
    EXPECT_EQ(taking.run(false, [](double) { return true; }), RenderEnd::done);
    return layers;
}

TEST(TileStopping, AFloorNeedsFewerSamplesThanAnEdge) {
    constexpr int samples = 64;
    RenderLayers layers = sampled(samples);
    int least = samples;
    int most = 0;
    for (int y = 0; y < height_px; ++y)
        for (int x = 0; x < width_px; ++x) {
            least = std::min(least, layers.samplesAt(x, y));
            most = std::max(most, layers.samplesAt(x, y));
            EXPECT_EQ(layers.samplesAt(x, y), layers.samplesAt(x & ~3, y & ~3));
        }
    EXPECT_GE(least, 8);
    EXPECT_LE(least, 32);
    EXPECT_EQ(most, samples);
}

TEST(TileStopping, TilesThatAreDoneGetNoMoreSamples) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(tower()).ok());
    const SampleSequence sequence(8);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, topView(25.0), 32, 32, sequence, kernel, tables);
    RenderLayers layers(32, 32);
    kernel.render_block(setup, {0, 0, 32, 32}, 0, 4, layers.sums());
    layers.done()[9] = 1; // the second of the second row
    const float before = layers.at(RenderPlane::sky_r, 5, 5);
    kernel.render_block(setup, {0, 0, 32, 32}, 4, 8, layers.sums());
    EXPECT_EQ(layers.at(RenderPlane::sky_r, 5, 5), before);
    EXPECT_EQ(layers.samplesAt(5, 5), 4);
    EXPECT_EQ(layers.samplesAt(3, 5), 8);
    EXPECT_GT(layers.at(RenderPlane::sky_r, 3, 5), before) << "beside it twice the light came";
}

TEST(TileStopping, StoppingEarlyLeavesThePictureAsGood) {
    const auto mean = [](const RenderLayers& layers) {
        double light = 0.0;
        for (int y = 0; y < height_px; ++y)
            for (int x = 0; x < width_px; ++x)
                light += double{layers.at(RenderPlane::sky_g, x, y)} / layers.samplesAt(x, y);
        return light / (width_px * height_px);
    };
    const double wanted = mean(sampled(1024));
    EXPECT_NEAR(mean(sampled(32)), wanted, 0.01 * wanted);
}

TEST(TileStopping, HalvesAreThoseOfTheSums) {
    RenderLayers layers = sampled(2);
    for (const auto& [sum, even] : {std::pair(RenderPlane::sky_r, RenderPlane::even_sky),
                                    {RenderPlane::albedo_r, RenderPlane::even_albedo}}) {
        double all = 0.0;
        double half = 0.0;
        for (int y = 0; y < height_px; ++y)
            for (int x = 0; x < width_px; ++x) {
                all += 0.2126 * double{layers.at(sum, x, y)} +
                       0.7152 * double{layers.at(sum + 1, x, y)} +
                       0.0722 * double{layers.at(sum + 2, x, y)};
                half += double{layers.at(even, x, y)};
            }
        EXPECT_NEAR(half, 0.5 * all, 0.01 * all);
    }
}

} // namespace
} // namespace quarn
