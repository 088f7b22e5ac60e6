#include "engine/display/LampModel.h"
#include "engine/display/SkyModel.h"
#include "tests/engine/display/LitScenes.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int SIZE = 64;

KM_Light lampAt(const KM_3dPoint& place, KM_LightStyle style = KM_LightStyle::world_point) {
    KM_Light lamp;
    lamp.SetStyle(style);
    lamp.SetLocation(place);
    return lamp;
}

/// A floor of two metres under lamps alone.
SceneContent darkFloor(std::vector<KM_Light> lamps) {
    SceneContent content;
    addMesh(content, floorMesh(-1, -1, 1, 1, 0), {255, 255, 255, 255});
    content.lights = std::move(lamps);
    content.light.surroundings = Surroundings::picture;
    content.light.picture = surroundingsBy([](float, float) {
        return std::array<float, 3>{0, 0, 0};
    });
    return content;
}

/// Linear light at a place of the floor, far below where bright light is held back.
double lightOn(SceneContent content, double x, double y) {
    content.light.exposure = -1.5;
    const Image image = litPicture(content, topView(1.0), SIZE, SIZE);
    return linearLight(image, static_cast<int>((1.0 + x) * SIZE / 2),
                       static_cast<int>((1.0 - y) * SIZE / 2));
}

TEST(Lamps, LightFallsWithTheSquareOfTheDistanceAndWithTheCosine) {
    const SceneContent content = darkFloor({lampAt({0, 0, 0.5})});
    const double below = lightOn(content, 0.02, 0.0);
    const double beside = lightOn(content, 0.5, 0.0);
    // 0.5 m beside: 1 / (2 * 0.25) of the light, under a cosine of sqrt(1/2).
    EXPECT_NEAR(beside / below, std::pow(0.5, 1.5), 0.02);
}

TEST(Lamps, SpotsShineWithinTheirConeAlone) {
    KM_Light spot = lampAt({0, 0, 0.5}, KM_LightStyle::world_spot);
    spot.SetDirection({0, 0, -3});
    const SceneContent cone = darkFloor({spot});
    const SceneContent round = darkFloor({lampAt({0, 0, 0.5})});
    EXPECT_NEAR(lightOn(cone, 0.1, 0.0), lightOn(round, 0.1, 0.0), 1e-6);
    EXPECT_EQ(lightOn(cone, 0.6, 0.0), 0.0);
    EXPECT_GT(lightOn(round, 0.6, 0.0), 0.0);
    const double edge = lightOn(cone, 0.5 * std::tan(40.0 * KM_PI / 180.0), 0.0);
    EXPECT_GT(edge, 0.0);
    EXPECT_LT(edge, lightOn(round, 0.42, 0.0));
}

TEST(Lamps, WhatStandsBeforeALampCastsItsShadow) {
    SceneContent content = darkFloor({lampAt({0, 0, 1.0})});
    addMesh(content, floorMesh(0.2F, -0.1F, 0.4F, 0.1F, 0.5F));
    // The plate's shadow reaches from 0.4 m to 0.8 m.
    EXPECT_EQ(lightOn(content, 0.6, 0.0), 0.0);
    EXPECT_GT(lightOn(content, -0.6, 0.0), 0.0);
    content.lights[0].SetShadowIntensity(0.0);
    EXPECT_GT(lightOn(content, 0.6, 0.0), 0.0);
}

TEST(Lamps, SmoothSurfacesShowTheirHighlight) {
    SceneContent content = darkFloor({lampAt({0, 0, 1.0})});
    addLook(content, sphereMesh({0, 0, 0.3}, 0.3F, 48), [](Material& material) {
        material.base_color = {0, 0, 0, 255};
        material.roughness = 0.3F;
    });
    EXPECT_GT(lightOn(content, 0.0, 0.0), 0.1);
    EXPECT_LT(lightOn(content, 0.25, 0.0), 0.02);
}

TEST(Lamps, TogetherTheyAreAsBrightInScenesOfEverySizeAndKeepTheirRelation) {
    const CameraFrame camera{nullptr, nullptr, nullptr};
    for (const double size : {0.01, 1.0, 500.0}) {
        const KM_BoundingBox box({0, 0, 0}, {size, size, size});
        std::vector<KM_Light> lights{lampAt({0, 0, size}), lampAt({size, 0, size})};
        auto lamps = lampsOf(lights, box, camera, {});
        ASSERT_EQ(lamps.size(), 2U);
        EXPECT_NEAR(lightOfLamps(lamps, box), 1.0F, 1e-4F);
        lights[1].SetIntensity(0.25);
        lamps = lampsOf(lights, box, camera, {});
        EXPECT_NEAR(lamps[1].color.g / lamps[0].color.g, 0.25F, 1e-5F);
        EXPECT_LT(lightOfLamps(lamps, box), 0.9F);
    }
}

TEST(Lamps, TheMedianPlaceSaysHowBrightTheyAre) {
    const CameraFrame camera{nullptr, nullptr, nullptr};
    const KM_BoundingBox box({0, 0, 0}, {1, 1, 1});
    // In the first of the places: in thirds of the box the squares of the distances to the others
    // are, sorted, 0 1 1 1 2 2 2 3 4 4 4 5 5 5 5 5 5 6 6 6 8 8 8 9 9 9 12. The middle one is 5.
    const std::vector<KM_Light> lights{lampAt({1.0 / 6.0, 1.0 / 6.0, 1.0 / 6.0})};
    const auto lamps = lampsOf(lights, box, camera, {});
    ASSERT_EQ(lamps.size(), 1U);
    EXPECT_NEAR(lamps[0].color.g, 5.0F / 9.0F, 1e-5F);
}

TEST(Lamps, TheyDimTheStudioSoThatTheWholeStaysAsBright) {
    SceneContent content = cubeOnGround();
    const LitFrame dark = frameOf(content, productView());
    content.lights = {lampAt({0.5, -0.5, 1.0})};
    const LitFrame lit = frameOf(content, productView());
    EXPECT_NEAR(lit.frame.exposure, 0.5F, 1e-3F);
    EXPECT_NEAR(ambientOn(lit.frame, 0, 0, 1), 0.5 * ambientOn(dark.frame, 0, 0, 1), 1e-3);
    content.lights[0].Enable(false);
    EXPECT_EQ(frameOf(content, productView()).frame.lamp_count, 0);
}

TEST(Lamps, ManyMoreThanAreDrawnDoNoHarm) {
    std::vector<KM_Light> lights;
    for (int i = 0; i < 100; ++i) {
        lights.push_back(lampAt({0.01 * i, 0, 1.0}));
        lights.back().SetIntensity(i == 99 ? 1.0 : 0.001);
    }
    const LitFrame lit = frameOf(darkFloor(lights), productView());
    EXPECT_EQ(lit.frame.lamp_count, max_lamps);
    EXPECT_NEAR(lit.frame.lamps[0].place[0], 0.99F, 1e-5F);
}

TEST(Lamps, LightOnTheModelIsTheSameWhereverItLies) {
    const auto lightFar = [](double offset) {
        SceneContent content;
        addMesh(content, floorMesh(static_cast<float>(offset) - 1, -1,
                                   static_cast<float>(offset) + 1, 1, 0));
        content.lights = {lampAt({offset, 0, 0.8})};
        content.light.surroundings = Surroundings::studio;
        KM_Viewport view = topView(1.0);
        view.SetCameraLocation(view.CameraLocation() + KM_3dVector(offset, 0, 0));
        return litPicture(content, view, SIZE, SIZE);
    };
    const Image here = lightFar(0.0);
    const Image there = lightFar(65536.0);
    EXPECT_NEAR(brightness(here, 40, 30), brightness(there, 40, 30), 1.0);
}

} // namespace
} // namespace quarn
