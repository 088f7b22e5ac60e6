#include "engine/render/RenderEncoding.h"
#include "engine/render/SampleTaking.h"
#include "tests/engine/display/LitScenes.h"
#include "tests/engine/render/RenderFixture.h"

namespace quarn {
namespace {

constexpr int SIZE = 48;
constexpr int SAMPLES = 32;

SceneContent cubeBefore(BackgroundKind kind, bool has_ground) {
    SceneContent content = cubeOnGround({200, 40, 40, 255});
    content.light.surroundings = Surroundings::studio;
    content.light.background = kind;
    content.light.has_ground = has_ground;
    return content;
}

int alphaAt(const Image& image, int x, int y) {
    return image.pixel(x, y)[3];
}

TEST(RenderedBackground, ATransparentOneLeavesTheModelAloneWithoutAGround) {
    const Image image = rendered(cubeBefore(BackgroundKind::transparent, false), topView(0.5),
                                 {SIZE, SIZE, SAMPLES});
    EXPECT_EQ(alphaAt(image, SIZE / 2, SIZE / 2), 255);
    for (const auto& [x, y] : {std::pair(0, 0), {SIZE - 1, 0}, {0, SIZE - 1}, {SIZE / 2, 2}})
        EXPECT_EQ(alphaAt(image, x, y), 0) << x << ' ' << y;
}

TEST(RenderedBackground, OnATransparentOneAGroundIsAsOpaqueAsItsShadow) {
    const Image image = rendered(cubeBefore(BackgroundKind::transparent, true), topView(0.5),
                                 {SIZE, SIZE, SAMPLES});
    const int beside = SIZE / 2 + SIZE / 5 + 2;
    EXPECT_GT(alphaAt(image, beside, SIZE / 2), 10);
    EXPECT_LT(alphaAt(image, beside, SIZE / 2), 250);
    EXPECT_LT(alphaAt(image, 0, 0), alphaAt(image, beside, SIZE / 2));
    for (int c = 0; c < 3; ++c)
        EXPECT_LT(image.pixel(beside, SIZE / 2)[c], 90) << "a shadow is dark";
}

/// A picture as it is shown when all its samples are taken, and the finished one.
std::pair<Image, Image> lastAndFinished(const SceneContent& content, const KM_Viewport& viewport) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    const SampleSequence sequence(SAMPLES);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, viewport, SIZE, SIZE, sequence, kernel, tables);
    RenderLayers layers(SIZE, SIZE);
    SampleTaking(setup, kernel, layers, SAMPLES).run(false, [](double) { return true; });
    Image last;
    last.resize(SIZE, SIZE);
    for (int y = 0; y < SIZE; ++y)
        encodeRow(layers, setup.frame, y, last);
    return {last, rendered(content, viewport, {SIZE, SIZE, SAMPLES})};
}

TEST(RenderedBackground, ThePictureOnTheWayHasTheGroundOfTheFinishedOne) {
    for (const BackgroundKind kind : {BackgroundKind::automatic, BackgroundKind::transparent}) {
        const auto& [last, finished] = lastAndFinished(cubeBefore(kind, true), topView(0.5));
        for (int y = 0; y < SIZE; y += 5)
            for (int x = 0; x < SIZE; x += 5)
                for (int c = 0; c < 4; ++c)
                    EXPECT_NEAR(last.pixel(x, y)[c], finished.pixel(x, y)[c], 40)
                        << x << ' ' << y << ' ' << c;
        for (int c = 0; c < 4; ++c)
            EXPECT_NEAR(last.pixel(1, 1)[c], finished.pixel(1, 1)[c], 8) << "far from the shadow";
    }
}

TEST(RenderedSurfaces, TheBackOfAOneSidedOneIsNotSeen) {
    const auto from_above = [](bool is_turned) {
        SceneContent content;
        addMesh(content, floorMesh(-9, -9, 9, 9, 0), {40, 160, 60, 255});
        KM_Mesh lid = floorMesh(-3, -3, 3, 3, 2);
        for (KM_MeshTriangle& triangle : lid.m_F)
            if (is_turned)
                std::swap(triangle.vi[1], triangle.vi[2]);
        addLook(content, std::move(lid), [](Material& material) {
            material.base_color = {200, 40, 40, 255};
            material.is_one_sided = true;
        });
        const Image image = rendered(content, topView(5.0), {SIZE, SIZE, 8});
        return image.pixel(SIZE / 2, SIZE / 2)[0] > image.pixel(SIZE / 2, SIZE / 2)[1];
    };
    EXPECT_TRUE(from_above(false));
    EXPECT_FALSE(from_above(true));
}

TEST(RenderedSurfaces, ShadowsThatAPictureOfOcclusionHoldsAreLeftToTheLightItself) {
    const auto floor = [](bool has_occlusion) {
        SceneContent content;
        addLook(content, floorMesh(-9, -9, 9, 9, 0), [&](Material& material) {
            material.base_color = {180, 180, 180, 255};
            if (has_occlusion)
                material.occlusion.texture = textureOf(2, 2, [](int, int) {
                    return std::array<std::uint8_t, 4>{40, 40, 40, 255};
                });
        });
        return rendered(content, topView(5.0), {SIZE, SIZE, 8});
    };
    EXPECT_TRUE(floor(true).rgba == floor(false).rgba);
}

} // namespace
} // namespace quarn
