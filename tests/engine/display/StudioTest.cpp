#include "engine/images/ColorSpace.h"
#include "tests/engine/display/LitScenes.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace quarn {
namespace {

constexpr int SIZE = 96;

TEST(Studio, LightFromAroundIsTheSameWhereverTheCameraStands) {
    const SceneContent content = cubeOnGround();
    const LitFrame front = frameOf(content, productView());
    const LitFrame back = frameOf(content, perspectiveView({-1, 2, 0.1}, {0, 0, 0.1}));
    for (int c = 0; c < 3; ++c) {
        EXPECT_EQ(front.frame.ambient_base[c], back.frame.ambient_base[c]);
        for (int i = 0; i < 3; ++i)
            EXPECT_EQ(front.frame.ambient_slope[c][i], back.frame.ambient_slope[c][i]);
    }
    EXPECT_EQ(front.frame.exposure, back.frame.exposure);
}

TEST(Studio, WhiteGetsAboutAsMuchLightAsItCanShowAndEachSideOfABoxAnother) {
    const LitFrame lit = frameOf(cubeOnGround(), productView());
    const double above = ambientOn(lit.frame, 0, 0, 1);
    EXPECT_GT(above, 0.9);
    EXPECT_LT(above, 1.2);
    const double left = ambientOn(lit.frame, -1, 0, 0);
    const double right = ambientOn(lit.frame, 1, 0, 0);
    EXPECT_GT(above, left + 0.08);
    EXPECT_GT(left, right + 0.08);
    EXPECT_GT(right, 0.45);
}

TEST(Studio, AmbientLightIsTheMeanOfWhatLiesAroundByTheCosine) {
    const LitFrame lit = frameOf(cubeOnGround(), productView());
    const RayKernel& kernel = rayKernelInForce();
    // A sum over equal steps of the sine squared and of the angle around: equal parts of the light.
    for (const bool up : {true, false}) {
        double sum = 0.0;
        constexpr int RINGS = 128;
        for (int ring = 0; ring < RINGS; ++ring) {
            alignas(64) float toward[3][lane_count];
            alignas(64) float light[3][lane_count];
            const double square = (ring + 0.5) / RINGS;
            for (int i = 0; i < lane_count; ++i) {
                const double around = 2.0 * KM_PI * (i + 0.618 * ring) / lane_count;
                toward[0][i] = static_cast<float>(std::sqrt(square) * std::cos(around));
                toward[1][i] = static_cast<float>(std::sqrt(square) * std::sin(around));
                toward[2][i] = static_cast<float>((up ? 1 : -1) * std::sqrt(1.0 - square));
            }
            kernel.find_light_around(lit.frame, toward, light);
            for (const float part : light[1])
                sum += part / (RINGS * lane_count);
        }
        // Nine functions of the sphere leave out a few hundredths of such light at the most.
        EXPECT_NEAR(ambientOn(lit.frame, 0, 0, up ? 1 : -1), sum, 0.04) << up;
    }
}

TEST(Studio, TheGroundMeltsIntoTheBackdropWithoutALine) {
    SceneContent content = cubeOnGround();
    const KM_Viewport view = perspectiveView({0.6, -2.0, 0.6}, {0.0, 0.0, 0.3});
    const Image with = litPicture(content, view, SIZE, SIZE);
    content.light.has_ground = false;
    const Image without = litPicture(content, view, SIZE, SIZE);
    for (int y = 0; y < SIZE; ++y)
        EXPECT_TRUE(samePixel(with, 0, y, without, 0, y)) << y;
    EXPECT_GT(brightness(with, 0, SIZE - 1), 225.0);
}

TEST(Studio, ASoftShadowLiesWhereSomethingStandsOnTheGround) {
    const SceneContent content = cubeOnGround();
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE);
    // Half a metre is 48 pixels: the box's side at 0.1 m lies 9.6 pixels from the middle.
    const int y = SIZE / 2;
    double before = 0.0;
    for (int x = SIZE / 2 + 10; x < SIZE; ++x) {
        const double now = brightness(image, x, y);
        EXPECT_GE(now, before - 1.0) << x;
        EXPECT_LT(now - before, x == SIZE / 2 + 10 ? 256.0 : 30.0) << x;
        before = now;
    }
    EXPECT_LT(brightness(image, SIZE / 2 + 10, y), before - 40.0);
}

TEST(Studio, ShadowsGoWithWhatIsHidden) {
    SceneContent content = cubeOnGround();
    for (const double x : {-0.4, 0.4}) // the box of all stays the same
        addMesh(content, boxMesh({x - 0.05, -0.1, 0.0}, {x + 0.05, 0.1, 0.2}));
    DisplayScene scene;
    DisplayPipeline pipeline;
    Image shown;
    Image hidden;
    const auto draw = [&](Image& image) {
        ASSERT_TRUE(scene.update(content).ok());
        ASSERT_TRUE(
            pipeline.draw(scene, topView(0.5), modeNamed(L"Rendered"), SIZE, SIZE, image).ok());
    };
    draw(shown);
    content.meshes[0].visible = false;
    draw(hidden);
    EXPECT_GT(brightness(hidden, SIZE / 2 + 11, SIZE / 2),
              brightness(shown, SIZE / 2 + 11, SIZE / 2) + 30.0);
}

TEST(Studio, AShadowIsTheSameWhicheverFrameIsDrawnFirst) {
    const SceneContent content = cubeOnGround();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    DisplayPipeline pipeline;
    const DisplayModeAttributes mode = modeNamed(L"Rendered", 2);
    Image other;
    Image second;
    ASSERT_TRUE(pipeline.draw(scene, topView(0.5), mode, SIZE, SIZE, other).ok());
    ASSERT_TRUE(pipeline.draw(scene, productView(), mode, SIZE, SIZE, second).ok());
    EXPECT_EQ(second.rgba, litPicture(content, productView(), SIZE, SIZE, 2).rgba);
}

TEST(Studio, AllProcessorsShowTheSamePicture) {
    SceneContent content = cubeOnGround();
    addLook(content, sphereMesh({0.25, 0, 0.1}, 0.1F, 24), [](Material& material) {
        material.metalness = 1.0F;
        material.roughness = 0.2F;
    });
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_point);
    lamp.SetLocation({0.3, -0.4, 0.6});
    content.lights.push_back(lamp);
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    Image best;
    Image baseline;
    DisplayPipeline quick;
    DisplayPipeline plain(baseline_ray_kernel);
    const DisplayModeAttributes mode = modeNamed(L"Rendered", 1);
    ASSERT_TRUE(quick.draw(scene, productView(), mode, SIZE, SIZE, best).ok());
    ASSERT_TRUE(plain.draw(scene, productView(), mode, SIZE, SIZE, baseline).ok());
    EXPECT_EQ(best.rgba, baseline.rgba);
}

} // namespace
} // namespace quarn
