#include "engine/scene/DrawableRange.h"

#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <limits>

namespace quarn {
namespace {

constexpr double nan = std::numeric_limits<double>::quiet_NaN();
constexpr double infinite = std::numeric_limits<double>::infinity();

/// Far beyond the limit, just beyond it, and no numbers at all.
const double beyond_range[] = {1.01e12, 1e16, 1e19, 1e38, -1e19, 1e300, infinite, -infinite, nan};

KM_Viewport cornerView() {
    return perspectiveView({3.0, -4.0, 3.0}, KM_3dPoint::Origin);
}

SceneContent boxInTheSun() {
    SceneContent content;
    addMesh(content, boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}), {200, 80, 60, 255});
    content.lights.push_back(sunLight({0.4, 0.5, -0.7}));
    return content;
}

KM_3dPointArray lineTo(double x) {
    KM_3dPointArray points;
    points.Append({0.0, 0.0, 2.0});
    points.Append({x, 0.0, 2.0});
    return points;
}

std::vector<Image> inAllModes(const SceneContent& content, const KM_Viewport& camera) {
    std::vector<Image> pictures;
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        pictures.push_back(drawn(content, camera, mode, 60, 40));
    return pictures;
}

void expectSame(const std::vector<Image>& pictures, const std::vector<Image>& others) {
    for (std::size_t i = 0; i < pictures.size(); ++i)
        EXPECT_TRUE(pictures[i].rgba == others[i].rgba)
            << KM_wString(standardDisplayModes()[i].english_name).ToUtf8();
}

std::vector<KM_UUID> outOfRange(const SceneContent& content) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    return {scene.outOfRange().begin(), scene.outOfRange().end()};
}

TEST(DrawableRange, EveryKindOfObjectBeyondItIsListedAndLeavesThePictureAsItIs) {
    const std::vector<Image> alone = inAllModes(boxInTheSun(), cornerView());
    for (const double far : beyond_range) {
        SCOPED_TRACE(far);
        SceneContent content = boxInTheSun();
        SceneMesh moved = content.meshes[0];
        moved.id = KM_CreateUuid();
        moved.placed.world_from_mesh = KM_Xform::Translation(far, 0.0, 0.0);
        content.meshes.push_back(moved);
        KM_Mesh stretched = boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0});
        stretched.m_V[3].y = static_cast<float>(far);
        addMesh(content, std::move(stretched));
        content.curves.push_back({KM_CreateUuid(), lineTo(far)});
        content.points.push_back({KM_CreateUuid(), {0.0, far, 0.0}});
        const std::vector<KM_UUID> all = {content.meshes[1].id, content.meshes[2].id,
                                          content.curves[0].id, content.points[0].id};
        EXPECT_EQ(outOfRange(content), all);
        expectSame(inAllModes(content, cornerView()), alone);
    }
}

TEST(DrawableRange, WhatReachesJustUpToItIsDrawn) {
    const SceneContent near = boxInTheSun();
    SceneContent content = near;
    content.curves.push_back({KM_CreateUuid(), lineTo(1e12)});
    content.points.push_back({KM_CreateUuid(), {0.0, 0.0, -1e12}});
    addMesh(content, floorMesh(-1e12F, -1e12F, 1e12F, 1e12F, -2.0F));
    EXPECT_TRUE(outOfRange(content).empty());
    const DisplayModeAttributes shaded = modeNamed(L"Shaded");
    EXPECT_FALSE(drawn(content, cornerView(), shaded, 60, 40).rgba ==
                 drawn(near, cornerView(), shaded, 60, 40).rgba);
}

TEST(DrawableRange, ScalesWithoutAnInverseInSinglePrecisionAreBeyondIt) {
    for (const double scale : {1e-13, 1e-30, 1e-310, 1e13, 1e300, infinite, nan, 0.0}) {
        SceneContent content = boxInTheSun();
        content.meshes[0].placed.world_from_mesh = KM_Xform::Diagonal(scale, scale, scale);
        EXPECT_EQ(outOfRange(content).size(), 1U) << scale;
    }
    SceneContent sheared = boxInTheSun();
    KM_Xform& place = sheared.meshes[0].placed.world_from_mesh;
    for (int row = 0; row < 3; ++row)
        for (int column = 0; column < 3; ++column)
            place.m_xform[row][column] = row == column ? 1.0 + 1e-9 : 1.0;
    EXPECT_EQ(outOfRange(sheared).size(), 1U);
}

TEST(DrawableRange, AMeshOfExtremeScaleLooksLikeOneOfThatSize) {
    const auto pictures = [](double scale, double in_mesh) {
        SceneContent content;
        KM_Mesh mesh = sphereMesh(KM_3dPoint::Origin, 1.0F, 12);
        mesh.Append(boxMesh({0.2, 0.2, -1.0}, {1.3, 1.1, 0.9}));
        for (KM_3fPoint& v : mesh.m_V)
            v = KM_3fPoint(v.ToDouble() * in_mesh);
        addMesh(content, std::move(mesh));
        content.meshes[0].placed.world_from_mesh =
            KM_Xform::Scale(KM_3dPoint::Origin, scale / in_mesh);
        content.lights.push_back(sunLight({0.4, 0.5, -0.7}));
        KM_Viewport view = perspectiveView({3.0 * scale, -4.0 * scale, 3.0 * scale}, {});
        view.SetFrustumNearFar(0.1 * scale, 100.0 * scale);
        return inAllModes(content, view);
    };
    const std::vector<Image> usual = pictures(1.0, 1.0);
    for (const double scale : {0x1p-34, 0x1p-20, 0x1p20, 0x1p38}) {
        SCOPED_TRACE(scale);
        expectSame(pictures(scale, 1.0), usual);
        expectSame(pictures(scale, scale), usual);
    }
}

TEST(DrawableRange, AVerySmallScaleCannotStandBesideAVeryLargeModel) {
    SceneContent content = boxInTheSun();
    content.meshes[0].placed.world_from_mesh = KM_Xform::Scale(KM_3dPoint::Origin, 1e-9);
    EXPECT_TRUE(outOfRange(content).empty());
    addMesh(content, floorMesh(-1e11F, -1e11F, 1e11F, 1e11F, -2.0F));
    EXPECT_EQ(outOfRange(content), std::vector<KM_UUID>{content.meshes[0].id});
}

TEST(DrawableRange, CamerasBeyondItSeeTheBackgroundInAllModes) {
    SceneContent content = boxInTheSun();
    content.curves.push_back({KM_CreateUuid(), lineTo(3.0)});
    SceneContent nothing;
    nothing.lights = content.lights;
    const KM_Viewport inside = perspectiveView(KM_3dPoint::Origin, {0.0, 1.0, 0.0});
    const std::vector<Image> background = inAllModes(nothing, inside);
    for (const double far : {1.01e13, 1e18, 1e19, 1e40, 1e300}) {
        SCOPED_TRACE(far);
        KM_Viewport camera = inside;
        camera.SetCameraLocation({far, 0.0, 0.0});
        expectSame(inAllModes(content, camera), background);
        camera.SetCameraLocation({0.0, -far, far});
        expectSame(inAllModes(content, camera), background);
    }
}

TEST(DrawableRange, OpeningsWithoutEndOrWidthSeeTheBackground) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(boxInTheSun()).ok());
    KM_Viewport camera = cornerView();
    EXPECT_TRUE(scene.canBeSeenBy(camera, 60, 40));
    for (const double lens_mm : {1e-7, 1e-300, 1e200}) {
        ASSERT_TRUE(camera.SetCamera35mmLensLength(lens_mm)) << lens_mm;
        EXPECT_FALSE(scene.canBeSeenBy(camera, 60, 40)) << lens_mm;
    }
    KM_Viewport plan = topView(5.0);
    EXPECT_TRUE(scene.canBeSeenBy(plan, 60, 40));
    for (const double half : {1e14, 1e306, 1e-19, 1e-310}) {
        ASSERT_TRUE(plan.SetFrustum(-half, half, -half, half, 1.0, 2.0)) << half;
        EXPECT_FALSE(scene.canBeSeenBy(plan, 60, 40)) << half;
    }
}

TEST(DrawableRange, ALineThatLeavesThePictureVeryFarStillCrossesIt) {
    SceneContent content;
    KM_3dPointArray line;
    line.Append({-9e11, 0.0, 9e11});
    line.Append({9e11, 0.0, -9e11});
    content.curves.push_back({KM_CreateUuid(), line});
    const KM_Viewport camera = perspectiveView({0.0, -1e-3, 0.0}, KM_3dPoint::Origin);
    const Image image = drawn(content, camera, modeNamed(L"Shaded"), 41, 41);
    for (const int place : {0, 10, 20, 30, 40})
        EXPECT_LT(brightness(image, place, place), 60.0) << place;
    EXPECT_GT(brightness(image, 5, 35), 150.0);
}

} // namespace
} // namespace quarn
