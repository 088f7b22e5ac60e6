#include "engine/images/ColorSpace.h"
#include "engine/render/TintedLight.h"
#include "tests/engine/render/RenderFixture.h"

#include <algorithm>
#include <array>

namespace quarn {
namespace {

constexpr KM_Color red_glass{220, 60, 40, 128};
constexpr KM_Color wall_color{180, 190, 200, 255};

double shareOf(KM_Color color) {
    return color.a / 255.0;
}

std::array<double, 3> linear(KM_Color color) {
    const LinearColor light = linearFromColor(color);
    return {double{light.r}, double{light.g}, double{light.b}};
}

/// What comes through a pane: as much as it is not opaque, times one less its opacity for a colour
/// that the glass has not at all.
std::array<double, 3> passedBy(KM_Color glass) {
    const std::array<double, 3> color = linear(glass);
    const double brightest = *std::max_element(color.begin(), color.end());
    const double a = shareOf(glass);
    std::array<double, 3> passed{};
    for (std::size_t c = 0; c < 3; ++c)
        passed[c] = (1.0 - a) * (1.0 - a * (1.0 - color[c] / brightest));
    return passed;
}

/// The sums of a scene under its own lights alone, of which each pixel took 16 samples.
RenderLayers underTheSun(const SceneContent& content, const KM_Viewport& viewport, int size_px) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    const SampleSequence sequence(16);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, viewport, size_px, size_px, sequence, kernel, tables);
    RenderLayers layers(size_px, size_px);
    kernel.render_block(setup, {0, 0, size_px, size_px}, 0, 16, layers.sums());
    return layers;
}

double at(const RenderLayers& layers, int plane, std::size_t channel, int x, int y) {
    return double{layers.at(plane + static_cast<int>(channel), x, y)};
}

SceneContent floorUnderGlass(float height) {
    SceneContent content;
    addMesh(content, floorMesh(-300.0F, -300.0F, 300.0F, 300.0F, 0.0F), wall_color);
    addPane(content, floorMesh(-300.0F, -300.0F, 300.0F, 300.0F, height), red_glass);
    return content;
}

TEST(RenderedPanes, SkyLightComesThroughInTheColorOfTheGlass) {
    constexpr int samples = 1024;
    const RenderLayers layers = inEvenLight(floorUnderGlass(0.01F), topView(10.0), 8, samples);
    const double a = shareOf(red_glass);
    const auto glass = linear(red_glass);
    const auto wall = linear(wall_color);
    const auto passed = passedBy(red_glass);
    for (std::size_t c = 0; c < 3; ++c) {
        // The pane has all the sky above it; the floor what comes through, of which the eye sees
        // what is not covered by the pane.
        const double wanted = a * glass[c] + (1.0 - a) * wall[c] * passed[c];
        EXPECT_NEAR(at(layers, RenderPlane::sky_r, c, 4, 4) / samples, wanted, 0.03);
        EXPECT_NEAR(at(layers, RenderPlane::albedo_r, c, 4, 4) / samples,
                    a * glass[c] + (1.0 - a) * wall[c], 2e-3);
    }
    EXPECT_NEAR(layers.at(RenderPlane::cover, 4, 4) / samples, 1.0F, 1e-5F);
}

TEST(RenderedPanes, ShadowOfGlassHasItsColor) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), wall_color);
    addPane(content, floorMesh(-14.0F, -4.0F, -6.0F, 4.0F, 10.0F), red_glass);
    KM_Light sun = sunLight({1.0, 0.0, -1.0}); // throws the shadow from -10 to 0
    sun.SetShadowIntensity(1.0);
    content.lights = {sun};
    const RenderLayers layers = underTheSun(content, topView(20.0), 40);
    const auto passed = passedBy(red_glass);
    for (std::size_t c = 0; c < 3; ++c) {
        const double open = at(layers, RenderPlane::sun_r, c, 20, 34);
        EXPECT_GT(open, 0.0);
        EXPECT_NEAR(at(layers, RenderPlane::sun_r, c, 20, 20) / open, passed[c], 1e-4);
    }
}

TEST(RenderedPanes, ShadowsTakeTheSharedGeometrysOwnColors) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), wall_color);
    const KM_Color blue_glass{30, 60, 220, 128};
    const std::size_t red =
        addPane(content, floorMesh(-14.0F, -4.0F, -6.0F, 4.0F, 10.0F), red_glass);
    const std::size_t blue = addPane(content, floorMesh(0.0F, 0.0F, 1.0F, 1.0F, 0.0F), blue_glass);
    content.meshes[blue].placed.mesh = content.meshes[red].placed.mesh;
    content.meshes[blue].placed.world_from_mesh = KM_Xform::Translation(0.0, 12.0, 0.0);
    KM_Light sun = sunLight({1.0, 0.0, -1.0});
    sun.SetShadowIntensity(1.0);
    content.lights = {sun};
    const RenderLayers layers = underTheSun(content, topView(20.0), 40);
    for (std::size_t c = 0; c < 3; ++c) {
        const double open = at(layers, RenderPlane::sun_r, c, 34, 34);
        EXPECT_NEAR(at(layers, RenderPlane::sun_r, c, 20, 20) / open, passedBy(red_glass)[c], 1e-4);
        EXPECT_NEAR(at(layers, RenderPlane::sun_r, c, 20, 8) / open, passedBy(blue_glass)[c], 1e-4);
    }
}

TEST(RenderedPanes, BothSidesOfAGlassBoxCover) {
    SceneContent content;
    addPane(content, boxMesh({-4.0, -4.0, 0.0}, {4.0, 4.0, 2.0}), red_glass);
    constexpr int samples = 256;
    const RenderLayers layers = inEvenLight(content, topView(8.0), 16, samples);
    const double clear = 1.0 - shareOf(red_glass);
    EXPECT_NEAR(layers.at(RenderPlane::cover, 8, 8) / samples, 1.0 - clear * clear, 0.01);
    EXPECT_EQ(layers.at(RenderPlane::cover, 1, 1), 0.0F) << "beside it there is only the sky";
}

/// A house that keeps the size of the scene, and a sheet over a part of its floor.
SceneContent courtyard() {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), wall_color);
    addMesh(content, boxMesh({5.0, 5.0, 0.0}, {15.0, 15.0, 12.0}), {200, 80, 60, 255});
    content.lights = {sunLight({0.4, -0.5, -0.8})};
    return content;
}

KM_Mesh sheetWithTexture() {
    KM_Mesh mesh = floorMesh(-10.0F, -10.0F, 10.0F, 10.0F, 4.0F);
    mesh.m_T.assign(mesh.m_V.size(), KM_2fPoint(0.5F, 0.5F));
    return mesh;
}

TEST(RenderedPanes, ClearGlassAndCutoutsLeaveNoTrace) {
    const KM_Viewport view = perspectiveView({25.0, -30.0, 30.0}, {0.0, 0.0, 2.0});
    const Image open = rendered(courtyard(), view, {60, 40, 256});
    SceneContent glazed = courtyard();
    addPane(glazed, sheetWithTexture(), {255, 255, 255, 0});
    SceneContent with_holes = courtyard();
    const std::size_t sheet = addMesh(with_holes, sheetWithTexture());
    auto holes = std::make_shared<Material>();
    auto clear = std::make_shared<Texture>();
    clear->width = clear->height = 1;
    clear->rgba = {255, 255, 255, 0};
    holes->base_color_texture = clear;
    holes->alpha_cutout = true;
    with_holes.meshes[sheet].placed.material = holes;
    for (const SceneContent& content : {glazed, with_holes}) {
        const Image image = rendered(content, view, {60, 40, 256});
        int most = 0;
        for (std::size_t i = 0; i < image.rgba.size(); ++i)
            most = std::max(most, std::abs(int{image.rgba[i]} - int{open.rgba[i]}));
        EXPECT_LE(most, 6) << "the sheet changes nothing but the order of chances";
    }
}

TEST(RenderedPanes, ManyPanesComeToAnEnd) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), wall_color);
    for (int i = 1; i <= 40; ++i)
        addPane(content, floorMesh(-8.0F, -8.0F, 8.0F, 8.0F, static_cast<float>(i)),
                {250, 250, 250, 2});
    content.lights = {sunLight({0.1, 0.0, -1.0})};
    const Image image = rendered(content, topView(10.0), {16, 16, 4});
    EXPECT_GT(brightness(image, 8, 8), 0.5 * brightness(image, 0, 0));
}

TEST(RenderedPanes, PassedLightIsThatOfGreyGlassInItsOwnHue) {
    EXPECT_FLOAT_EQ(passedByPane(0.0F, 0.0F), 1.0F);
    EXPECT_FLOAT_EQ(passedByPane(1.0F, 1.0F), 0.0F);
    EXPECT_FLOAT_EQ(passedByPane(0.5F, 1.0F), 0.5F);
    EXPECT_FLOAT_EQ(passedByPane(0.5F, 0.0F), 0.25F);
}

} // namespace
} // namespace quarn
