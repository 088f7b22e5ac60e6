#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

KM_Light sunAt(double altitude, double azimuth) {
    const double a = altitude * KM_PI / 180.0;
    const double z = azimuth * KM_PI / 180.0;
    return sunLight({-std::sin(z) * std::cos(a), -std::cos(z) * std::cos(a), -std::sin(a)});
}

constexpr double altitudes[] = {0.5, 1.0, 2.0, 5.0, 10.0, 20.0, 45.0, 70.0, 89.9};
/// Where the sun adds enough to the floor's light for its shadow to be measured.
constexpr double altitudes_that_show[] = {2.0, 5.0, 10.0, 20.0, 45.0, 70.0};

/// As topView, for models of any size.
KM_Viewport planView(double half) {
    KM_Viewport viewport = topView(half);
    viewport.SetCameraLocation({0.0, 0.0, 10.0 * half});
    return viewport;
}

/// A plan with shadows and the same without.
struct Plan {
    Image shadowed;
    Image plain;
    bool isDark(int x, int y) const {
        return brightness(shadowed, x, y) < brightness(plain, x, y) - 0.4;
    }
    /// How many dark pixels follow each other in a row.
    int darkRun(int from, int row) const {
        int x = from;
        while (x < shadowed.width && isDark(x, row))
            ++x;
        return x - from;
    }
};

/// [-10, 10]^2 units of the model in 400 by 400 pixels.
Plan planOf(SceneContent& content, double unit) {
    const KM_Viewport viewport = planView(10.0 * unit);
    Plan plan;
    plan.shadowed = drawn(content, viewport, modeNamed(L"Rendered"), 400, 400);
    content.lights[0].SetShadowIntensity(0.0);
    plan.plain = drawn(content, viewport, modeNamed(L"Rendered"), 400, 400);
    return plan;
}

/// A wall of 1 by 6 units under a sun in the west. It is so high that its shadow reaches `length`
/// units to the east.
SceneContent wallUnderTheSun(double altitude, double length, double unit) {
    const double top = length * std::tan(altitude * KM_PI / 180.0);
    SceneContent content;
    addMesh(content,
            boxMesh({-0.5 * unit, -3.0 * unit, 0.0}, {0.5 * unit, 3.0 * unit, top * unit}));
    content.lights.push_back(sunAt(altitude, 270.0));
    return content;
}

TEST(ShadowPlace, EdgeOnTheGroundLiesWhereTheSunPutsItAtEveryHeightAndScale) {
    for (const double unit : {1e-3, 1.0, 1e4})
        for (const double altitude : altitudes_that_show) {
            SceneContent content = wallUnderTheSun(altitude, 8.0, unit);
            const Plan plan = planOf(content, unit);
            // 20 pixels a unit: it ends 8.5 units from the middle, at pixel 370.
            EXPECT_NEAR(plan.darkRun(211, 200), 370 - 211, 1) << unit << " " << altitude;
            int rows = 0; // as wide as the wall
            for (int y = 0; y < 400; ++y)
                rows += plan.isDark(300, y);
            EXPECT_NEAR(rows, 120, 1) << unit << " " << altitude;
        }
}

TEST(ShadowPlace, ShadowOnAFloorBeginsAtTheFootOfTheWall) {
    for (const double unit : {1e-3, 1.0, 1e4})
        for (const double altitude : altitudes_that_show) {
            SceneContent content = wallUnderTheSun(altitude, 4.0, unit);
            const auto half = static_cast<float>(10.0 * unit);
            addMesh(content, floorMesh(-half, -half, half, half, 0.0F));
            const Plan plan = planOf(content, unit);
            // The wall ends at pixel 210; right behind it the floor is dark, up to pixel 290.
            EXPECT_NEAR(plan.darkRun(211, 200), 290 - 211, 1) << unit << " " << altitude;
        }
}

TEST(ShadowPlace, LitGroundHasNoDarkPixelAtAnyHeight) {
    for (const double scale : {1e-3, 1.0, 1e4})
        for (const double altitude : altitudes) {
            SceneContent content;
            addMesh(content, floorMesh(-10 * float(scale), -10 * float(scale), 10 * float(scale),
                                       10 * float(scale), 0.0F));
            content.lights.push_back(sunAt(altitude, 250.0));
            const KM_Viewport viewport =
                perspectiveView({-4 * scale, -22 * scale, 9 * scale}, {0, 0, 0});
            DepthImage depth;
            const Image image = drawn(content, viewport, modeNamed(L"Rendered"), 200, 150, &depth);
            content.lights[0].SetShadowIntensity(0.0);
            const Image without = drawn(content, viewport, modeNamed(L"Rendered"), 200, 150);
            int dark = 0;
            for (int y = 0; y < 150; ++y)
                for (int x = 0; x < 200; ++x)
                    if (std::isfinite(depth.depth(x, y)))
                        dark += samePixel(image, x, y, without, x, y) ? 0 : 1;
            EXPECT_EQ(dark, 0) << scale << " " << altitude;
        }
}

/// How many pixels the sun changes inside: none may.
int leaks(SceneContent& content, const KM_Viewport& viewport, double altitude, double azimuth) {
    content.lights = {sunAt(altitude, azimuth)};
    const auto mode = modeNamed(L"Rendered");
    const Image with_sun = drawn(content, viewport, mode, 320, 240);
    content.lights[0].SetIntensity(0.0);
    const Image without = drawn(content, viewport, mode, 320, 240);
    int changed = 0;
    for (int y = 0; y < 240; ++y)
        for (int x = 0; x < 320; ++x)
            changed += samePixel(with_sun, x, y, without, x, y) ? 0 : 1;
    return changed;
}

/// A room of six slabs that only touch each other.
SceneContent roomOfSlabs(double s) {
    SceneContent content;
    const auto slab = [&](double x0, double y0, double z0, double x1, double y1, double z1) {
        addMesh(content, boxMesh({s * x0, s * y0, s * z0}, {s * x1, s * y1, s * z1}));
    };
    slab(-3, -3, -0.02, 3, 3, 0);
    slab(-3, -3, 2.5, 3, 3, 2.52);
    slab(-3, -3, 0, -2.98, 3, 2.5);
    slab(2.98, -3, 0, 3, 3, 2.5);
    slab(-2.98, 2.98, 0, 2.98, 3, 2.5);
    slab(-2.98, -3, 0, 2.98, -2.98, 2.5);
    return content;
}

TEST(ShadowPlace, NoSunComesIntoAClosedRoom) {
    for (const double scale : {1e-3, 1.0, 1e4}) {
        SceneContent room = roomOfSlabs(scale);
        for (const double altitude : {0.5, 5.0, 20.0, 45.0, 70.0, 90.0})
            for (const double azimuth : {10.0, 90.0, 180.0, 225.0})
                for (const double look : {0.0, 2.0, 4.0}) {
                    KM_Viewport viewport = perspectiveView(
                        {0.3 * scale, 0.2 * scale, 1.3 * scale},
                        {3 * scale * std::cos(look), 3 * scale * std::sin(look), 1.0 * scale});
                    viewport.SetCamera35mmLensLength(16.0);
                    EXPECT_EQ(leaks(room, viewport, altitude, azimuth), 0)
                        << scale << " " << altitude << " " << azimuth << " " << look;
                }
    }
}

TEST(ShadowPlace, NoSunComesIntoAFinelyMeshedShell) {
    KM_Mesh smooth = sphereMesh({0, 0, 0}, 4.0F, 150);
    KM_Mesh flat = smooth;
    flat.m_N.clear();
    KM_Viewport viewport = perspectiveView({0.3, 0.2, 0.1}, {3, 1, -0.5});
    viewport.SetCamera35mmLensLength(16.0);
    for (const KM_Mesh& shell : {smooth, flat}) {
        SceneContent content;
        addMesh(content, shell);
        for (const double altitude : {3.0, 30.0, 60.0})
            for (const double azimuth : {10.0, 130.0, 270.0})
                EXPECT_EQ(leaks(content, viewport, altitude, azimuth), 0)
                    << altitude << " " << azimuth << " " << shell.m_N.size();
    }
}

TEST(ShadowPlace, BorderOfLightOnACoarseSphereHasNoSteps) {
    SceneContent content;
    addMesh(content, sphereMesh({0, 0, 0}, 4.0F, 12));
    const KM_Viewport viewport = planView(5.0);
    for (const double altitude : {1.0, 5.0, 20.0, 45.0}) {
        content.lights = {sunAt(altitude, 270.0)};
        const Image image = drawn(content, viewport, modeNamed(L"Rendered"), 400, 400);
        // 40 pixels a unit. Light falls from the left; on the rows around the middle it goes over
        // into shade without a step.
        double steepest = 0.0;
        for (int y = 140; y < 260; y += 7)
            for (int x = 80; x < 320; ++x)
                steepest = std::max(
                    steepest, std::fabs(brightness(image, x + 1, y) - brightness(image, x, y)));
        EXPECT_LT(steepest, 6.0) << altitude;
    }
}

} // namespace
} // namespace quarn
