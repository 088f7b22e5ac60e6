#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

/// A pole of one square unit and three units high at the origin, on a wide floor, from above:
/// 200 pixels show 20 units.
SceneContent poleOnFloor() {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    addMesh(content, boxMesh({-0.5, -0.5, 0.0}, {0.5, 0.5, 3.0}));
    return content;
}

Image plan(const SceneContent& content, int level = 0) {
    return drawn(content, topView(10.0), modeNamed(L"Rendered", level), 200, 200);
}

TEST(LightAndShadow, ShadowOfAPoleHasTheLengthAndDirectionOfTheSun) {
    SceneContent content = poleOnFloor();
    // The sun stands in the west, 45 degrees high: the shadow reaches 3 units to the east.
    content.lights.push_back(sunLight({1.0, 0.0, -1.0}));
    const Image image = plan(content);
    const double lit = brightness(image, 100, 20);
    for (int x = 106; x < 134; ++x) // from the pole's side at 0.5 to 3.5 units
        EXPECT_LT(brightness(image, x, 100), 0.8 * lit) << x;
    EXPECT_NEAR(brightness(image, 136, 100), lit, 1.0);
    EXPECT_NEAR(brightness(image, 90, 100), lit, 1.0);
    EXPECT_NEAR(brightness(image, 120, 107), lit, 1.0); // as wide as the pole
    EXPECT_NEAR(brightness(image, 120, 92), lit, 1.0);
}

TEST(LightAndShadow, LowerSunCastsTheLongerShadow) {
    SceneContent content = poleOnFloor();
    // Altitude atan(1/2): the shadow is twice as long as the pole is high.
    content.lights.push_back(sunLight({0.0, 2.0, -1.0}));
    const Image image = plan(content);
    const double lit = brightness(image, 20, 100);
    EXPECT_LT(brightness(image, 100, 100 - 62), 0.85 * lit); // 6.2 units to the north
    EXPECT_NEAR(brightness(image, 100, 100 - 67), lit, 1.0);
}

TEST(LightAndShadow, ShadowFallsOnTheGroundPlaneBelowAModelWithoutAFloor) {
    SceneContent content;
    addMesh(content, boxMesh({-0.5, -0.5, 0.0}, {0.5, 0.5, 3.0}));
    content.lights.push_back(sunLight({1.0, 0.0, -1.0}));
    const Image image = plan(content);
    EXPECT_LT(brightness(image, 125, 100), 0.85 * brightness(image, 75, 100));
    EXPECT_GT(brightness(image, 141, 100), 0.98 * brightness(image, 59, 100));
}

TEST(LightAndShadow, ModesWithoutShadowsAndLightsWithoutShadowCastNone) {
    SceneContent content = poleOnFloor();
    content.lights.push_back(sunLight({1.0, 0.0, -1.0}));
    const Image shaded = drawn(content, topView(10.0), modeNamed(L"Shaded"), 200, 200);
    EXPECT_TRUE(samePixel(shaded, 120, 100, shaded, 20, 30));
    DisplayModeAttributes mode = modeNamed(L"Rendered");
    mode.casts_shadows = false;
    const Image without = drawn(content, topView(10.0), mode, 200, 200);
    EXPECT_TRUE(samePixel(without, 120, 100, without, 20, 30));
    content.lights[0].SetShadowIntensity(0.0);
    const Image weak = plan(content);
    EXPECT_TRUE(samePixel(weak, 120, 100, weak, 20, 30));
}

TEST(LightAndShadow, HiddenObjectCastsNoShadow) {
    SceneContent content = poleOnFloor();
    content.lights.push_back(sunLight({1.0, 0.0, -1.0}));
    content.meshes[1].visible = false;
    const Image image = plan(content);
    EXPECT_TRUE(samePixel(image, 120, 100, image, 20, 30));
}

TEST(LightAndShadow, LitPlaneHasNoDarkPixelsWhereverItLies) {
    for (const float far_away : {0.0F, 1000.0F, 60000.0F}) {
        SceneContent content;
        const float half = 5.0F + 0.001F * far_away;
        KM_Mesh mesh = floorMesh(far_away - half, -half, far_away + half, half, 0.3F * far_away);
        addMesh(content, std::move(mesh));
        content.lights.push_back(sunLight({0.6, 0.3, -0.2}));
        KM_Viewport viewport =
            perspectiveView({far_away - half, -3.0 * half, 0.3 * far_away + 2.0 * half},
                            {far_away, 0.0, 0.3 * far_away});
        DepthImage depth;
        const Image image = drawn(content, viewport, modeNamed(L"Rendered"), 300, 200, &depth);
        double least = 255.0;
        double most = 0.0;
        for (int y = 0; y < 200; ++y)
            for (int x = 0; x < 300; ++x)
                if (std::isfinite(depth.depth(x, y))) {
                    least = std::min(least, brightness(image, x, y));
                    most = std::max(most, brightness(image, x, y));
                }
        EXPECT_GT(most, 0.0);
        EXPECT_EQ(least, most) << far_away;
    }
}

TEST(LightAndShadow, BorderOfLightOnACoarseSphereShowsNoFacets) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 12)); // facets of 15 degrees
    content.lights.push_back(sunLight({1.0, 0.0, -0.35}));
    const Image with_shadows = plan(content);
    content.lights[0].SetShadowIntensity(0.0);
    const Image without = plan(content);
    int darker = 0;
    int on_sphere = 0;
    for (int y = 0; y < 200; ++y)
        for (int x = 0; x < 200; ++x) {
            if (std::hypot(x - 99.5, y - 99.5) > 37.0)
                continue;
            ++on_sphere;
            darker += brightness(with_shadows, x, y) < brightness(without, x, y) - 3.0 ? 1 : 0;
        }
    EXPECT_GT(on_sphere, 4000);
    EXPECT_LT(darker, on_sphere / 100); // a sphere casts no shadow on its lit side
}

TEST(LightAndShadow, SmoothNormalsGiveASmoothGradient) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 12));
    const Image image = drawn(content, topView(10.0), modeNamed(L"Shaded"), 200, 200);
    for (int x = 64; x < 135; ++x)
        EXPECT_LT(std::fabs(brightness(image, x, 100) - brightness(image, x + 1, 100)), 5.0) << x;
}

TEST(LightAndShadow, MeshTurnedInsideOutLooksTheSame) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 24));
    content.lights.push_back(sunLight({1.0, 0.5, -0.7}));
    const Image outward = plan(content);
    KM_Mesh turned = sphereMesh({0.0, 0.0, 0.0}, 4.0F, 24);
    for (KM_MeshTriangle& t : turned.m_F)
        std::swap(t.vi[1], t.vi[2]);
    for (KM_3fVector& n : turned.m_N)
        n = {-n.x, -n.y, -n.z};
    SceneContent other;
    addMesh(other, std::move(turned));
    other.lights = content.lights;
    const Image inward = plan(other);
    int different = 0;
    for (int y = 0; y < 200; ++y)
        for (int x = 0; x < 200; ++x)
            different += std::fabs(brightness(outward, x, y) - brightness(inward, x, y)) > 2.0;
    EXPECT_LT(different, 60); // rounding on the outline
}

TEST(LightAndShadow, NightIsDarkButReadable) {
    SceneContent content = poleOnFloor();
    content.lights.push_back(sunLight({0.3, 0.2, -0.8}));
    const KM_Viewport viewport = perspectiveView({-10.0, -14.0, 8.0}, {0.0, 0.0, 1.0});
    const auto mean = [&](const KM_3dVector& direction) {
        content.lights[0] = sunLight(direction);
        return meanBrightness(drawn(content, viewport, modeNamed(L"Rendered"), 160, 120));
    };
    const double day = mean({0.3, 0.2, -0.8});
    const double dusk = mean({0.8, 0.3, -0.08});
    const double night = mean({0.3, 0.2, 0.8}); // the sun shines upward: it stands below
    EXPECT_GT(day, 150.0);
    EXPECT_LT(dusk, day);
    EXPECT_LT(night, 0.65 * dusk);
    EXPECT_GT(night, 45.0);
}

TEST(LightAndShadow, SunBelowTheHorizonCastsNoShadow) {
    SceneContent content = poleOnFloor();
    content.lights.push_back(sunLight({1.0, 0.0, 0.3}));
    const Image image = plan(content);
    EXPECT_TRUE(samePixel(image, 120, 100, image, 20, 30));
}

TEST(LightAndShadow, LightSwitchedOffCountsAsNone) {
    SceneContent content = poleOnFloor();
    const Image none = plan(content);
    content.lights.push_back(sunLight({1.0, 0.0, -1.0}));
    content.lights[0].Enable(false);
    EXPECT_EQ(plan(content).rgba, none.rgba);
    content.lights[0].Enable(true);
    EXPECT_NE(plan(content).rgba, none.rgba);
}

TEST(LightAndShadow, NoModeOverexposesAWhiteModel) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 40), {255, 255, 255, 255});
    content.lights.push_back(sunLight({0.3, 0.2, -0.8}));
    for (const wchar_t* name : {L"Shaded", L"Rendered", L"Clay"}) {
        const Image image = drawn(content, topView(4.0), modeNamed(name), 100, 100);
        int white = 0;
        for (int y = 0; y < 100; ++y)
            for (int x = 0; x < 100; ++x)
                white += image.pixel(x, y)[1] >= 254;
        EXPECT_LT(white, 200);
    }
}

TEST(LightAndShadow, GroundNeverHidesAModelSeenFromBelow) {
    SceneContent content;
    addMesh(content, boxMesh({-3.0, -3.0, 0.0}, {3.0, 3.0, 1.0}), {220, 30, 30, 255});
    const Image image = drawn(content, perspectiveView({1.0, -4.0, -9.0}, {0.0, 0.0, 0.0}),
                              modeNamed(L"Rendered"), 100, 100);
    EXPECT_GT(image.pixel(50, 50)[0], image.pixel(50, 50)[1] + 40);
}

} // namespace
} // namespace quarn
