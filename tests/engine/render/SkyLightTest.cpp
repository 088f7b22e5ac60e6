#include "tests/engine/render/RenderFixture.h"

#include <cmath>

namespace quarn {
namespace {

TEST(SkyLight, FreeSurfaceUnderAUniformSkyHasTheSkysBrightness) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    const RenderLayers layers = inEvenLight(content, topView(10.0), 16, 32);
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x)
            EXPECT_NEAR(skyVisible(layers, x, y), 1.0, 1e-5) << x << ' ' << y;
}

TEST(SkyLight, FreeSphereIsEvenlyBrightUnderASkyAllAround) {
    SceneContent content;
    addMesh(content, sphereMesh(KM_3dPoint::Origin, 5.0F, 64));
    const RenderLayers layers = inEvenLight(content, topView(8.0), 16, 64);
    for (int y = 4; y < 12; ++y)
        for (int x = 4; x < 12; ++x)
            EXPECT_NEAR(skyVisible(layers, x, y), 1.0, 0.005) << x << ' ' << y;
}

/// A wall that is high and long hides of the sky above the floor, at distance d from a wall of
/// height h, (1 - cos a) / 2 of the cosine-weighted hemisphere, with tan a = h / d: the form factor
/// from a strip to a long perpendicular wall (J. R. Howell, "A Catalog of Radiation Heat Transfer
/// Configuration Factors", B-4 with an endless wall).
double hiddenByWall(double distance, double height) {
    return 0.5 * (1.0 - distance / std::hypot(distance, height));
}

TEST(SkyLight, FloorAtTheFootOfAWallSeesHalfTheSky) {
    SceneContent content;
    addMesh(content, floorMesh(-2000.0F, -2000.0F, 2000.0F, 2000.0F, 0.0F));
    addMesh(content, boxMesh({-20.0, -2000.0, 0.0}, {0.0, 2000.0, 40.0}), {0, 0, 0, 255});
    // The wall is black and sends no light. The camera hangs below the wall's upper edge, so that
    // the wall hides no floor.
    const RenderLayers layers = inEvenLight(content, topView(20.0), 80, 256);
    const auto mean_at = [&](int x) {
        double sum = 0.0;
        for (int y = 20; y < 60; ++y)
            sum += skyVisible(layers, x, y);
        return sum / 40.0;
    };
    // Two pixels a unit; the wall's side stands at x = 40.
    for (const int x : {40, 44, 56, 76}) {
        const double distance = (x + 0.5 - 40.0) / 2.0;
        EXPECT_NEAR(mean_at(x), 1.0 - hiddenByWall(distance, 40.0), 0.012) << distance;
    }
    EXPECT_LT(mean_at(40), 0.52);
}

TEST(SkyLight, OpenFloorIsAsBrightAsInRenderedMode) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    for (const KM_3dVector& shines : {KM_3dVector(0, 1, -1), KM_3dVector(0, 1, -0.1)}) {
        content.lights = {sunLight(shines)};
        const Image fast = drawn(content, topView(5.0), modeNamed(L"Rendered"), 16, 16);
        const Image slow = rendered(content, topView(5.0), {16, 16, 64});
        for (int c = 0; c < 3; ++c)
            EXPECT_NEAR(slow.pixel(8, 8)[static_cast<std::size_t>(c)],
                        fast.pixel(8, 8)[static_cast<std::size_t>(c)], 2)
                << c;
    }
}

TEST(SkyLight, CornerIsDarkerThanTheOpenFloor) {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), {120, 120, 120, 255});
    addMesh(content, boxMesh({-10.0, -30.0, 0.0}, {0.0, 30.0, 20.0}), {120, 120, 120, 255});
    addMesh(content, boxMesh({-10.0, -30.0, 0.0}, {30.0, -10.0, 20.0}), {120, 120, 120, 255});
    content.lights = {sunLight({0, 0, 1})}; // below the horizon: the sky alone shines
    const Image image = rendered(content, topView(20.0), {80, 80, 64});
    const double open = brightness(image, 78, 20);
    const double corner = brightness(image, 42, 57); // 1 unit from both walls
    EXPECT_LT(corner, 0.9 * open);
    EXPECT_GT(corner, 0.3 * open) << "the walls send light too";
}

} // namespace
} // namespace quarn
