#pragma once

#include "engine/sunhours/PicturePoints.h"
#include "engine/sunhours/SunSampling.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

namespace quarn {

/// The sun of a day in steps of so many minutes, by the spherical triangle of pole, zenith and sun;
/// noon is at 12:00.
inline std::vector<SunStep> sunOfDay(double latitude_deg, double declination_deg, int minutes) {
    constexpr double RADIANS = std::numbers::pi / 180.0;
    const double phi = latitude_deg * RADIANS;
    const double delta = declination_deg * RADIANS;
    std::vector<SunStep> steps;
    for (double minute = 0.5 * minutes; minute < 1440.0; minute += minutes) {
        const double h = (minute / 4.0 - 180.0) * RADIANS;
        steps.push_back(
            {{-std::cos(delta) * std::sin(h),
              std::sin(delta) * std::cos(phi) - std::cos(delta) * std::sin(phi) * std::cos(h),
              std::sin(delta) * std::sin(phi) + std::cos(delta) * std::cos(phi) * std::cos(h)},
             minutes / 60.0});
    }
    return steps;
}

/// The hours of points of surfaces.
inline SunLight sunOn(const DisplayScene& scene, const SurfacePoints& points,
                      const std::vector<SunStep>& steps) {
    SunLight light;
    EXPECT_TRUE(findSun(
        scene, points, steps, true, [](double) { return true; }, light));
    return light;
}

/// The hours of the middle of a picture of 64 by 64 pixels; negative where no surface is.
inline double hoursInMiddle(const SceneContent& content, const KM_Viewport& viewport,
                            const std::vector<SunStep>& steps) {
    DisplayScene scene;
    const Result<void> updated = scene.update(content);
    EXPECT_TRUE(updated.ok()) << updated.message();
    const PicturePlace middle{32.5F, 32.5F};
    const PicturePoints seen = pointsSeen(scene, viewport, 64, 64, {&middle, 1});
    return seen.object[0] == 0 ? -1.0 : double{sunOn(scene, seen.points, steps).hours[0]};
}

/// The rectangle that stands on the line from a to b, `height` high.
inline KM_Mesh wallMesh(const KM_3dPoint& a, const KM_3dPoint& b, double height) {
    KM_Mesh mesh;
    for (const KM_3dPoint& p : {a, b, b + KM_3dVector(0, 0, height), a + KM_3dVector(0, 0, height)})
        mesh.m_V.emplace_back(static_cast<float>(p.x), static_cast<float>(p.y),
                              static_cast<float>(p.z));
    mesh.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    return mesh;
}

} // namespace quarn
