#include "kelmar/KM_Viewport.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace {

// At (10, 20, 30), looking along +Y with up along +Z; opening 45 degrees up and down; 400 by 200
// pixels.
KM_Viewport camera(KM_ViewProjection projection = KM_perspective_view) {
    KM_Viewport viewport;
    viewport.SetTargetPoint(KM_3dPoint::UnsetPoint);
    viewport.SetProjection(projection);
    viewport.SetCameraLocation(KM_3dPoint(10, 20, 30));
    viewport.SetCameraDirection(KM_3dVector(0, 1, 0));
    viewport.SetCameraUp(KM_3dVector(0, 0, 1));
    viewport.SetFrustum(-2, 2, -1, 1, 1, 101);
    viewport.SetScreenPort(400, 200);
    return viewport;
}

void expectScreen(const KM_Viewport& viewport, const KM_3dPoint& point, double x, double y,
                  double depth) {
    double actual_x = 0, actual_y = 0, actual_depth = 0;
    ASSERT_TRUE(viewport.WorldToScreen(point, &actual_x, &actual_y, &actual_depth));
    EXPECT_NEAR(actual_x, x, 1e-11);
    EXPECT_NEAR(actual_y, y, 1e-11);
    EXPECT_NEAR(actual_depth, depth, 1e-13);
}

} // namespace

TEST(Projecting, TheMiddleOfThePictureIsStraightAhead) {
    expectScreen(camera(), KM_3dPoint(10, 25, 30), 200, 100, 5);
}

TEST(Projecting, PixelsRunRightAndDown) {
    // At depth 10 the picture is 40 wide and 20 high.
    expectScreen(camera(), KM_3dPoint(15, 30, 30), 250, 100, 10);
    expectScreen(camera(), KM_3dPoint(10, 30, 35), 200, 50, 10);
    expectScreen(camera(), KM_3dPoint(-10, 30, 40), 0, 0, 10);
    expectScreen(camera(), KM_3dPoint(60, 30, 30), 700, 100, 10); // outside the picture
}

TEST(Projecting, ParallelViewsShowTheSameSizeAtEveryDepth) {
    const KM_Viewport viewport = camera(KM_parallel_view);
    expectScreen(viewport, KM_3dPoint(11, 30, 30), 300, 100, 10);
    expectScreen(viewport, KM_3dPoint(11, 90, 30), 300, 100, 70);
    expectScreen(viewport, KM_3dPoint(11, 10, 30), 300, 100, -10);
}

TEST(Projecting, OffCentreFrustumsMoveThePicture) {
    KM_Viewport viewport = camera();
    ASSERT_TRUE(viewport.SetFrustum(0, 4, 0, 2, 1, 101));
    expectScreen(viewport, KM_3dPoint(10, 25, 30), 0, 200, 5);
}

TEST(Projecting, WhatIsNotInFrontOfTheCameraIsNotSeen) {
    double x = -7, y = -7, depth = -7;
    EXPECT_FALSE(camera().WorldToScreen(KM_3dPoint(10, 20, 30), &x, &y, &depth));
    EXPECT_FALSE(camera().WorldToScreen(KM_3dPoint(10, 15, 30), &x, &y, &depth));
    EXPECT_FALSE(camera().WorldToScreen(KM_3dPoint::UnsetPoint, &x, &y, &depth));
    EXPECT_EQ(x, -7);
    EXPECT_EQ(y, -7);
    EXPECT_EQ(depth, -7);
    EXPECT_TRUE(camera().WorldToScreen(KM_3dPoint(10, 21, 30), nullptr, nullptr, nullptr));
}

TEST(Projecting, NothingCanBeProjectedWithoutACameraFrame) {
    KM_Viewport viewport = camera();
    viewport.SetCameraDirection(KM_3dVector(0, 0, 1));
    ASSERT_FALSE(viewport.IsValidCamera());
    double x = 0;
    KM_Xform xform = KM_Xform::Diagonal(7, 7, 7);
    const KM_Xform before = xform;
    KM_3dPoint origin;
    KM_3dVector direction;
    KM_Line line;
    EXPECT_FALSE(viewport.WorldToScreen(KM_3dPoint(10, 25, 30), &x, nullptr, nullptr));
    EXPECT_FALSE(viewport.GetWorldFromCamera(xform));
    EXPECT_FALSE(viewport.GetCameraFromWorld(xform));
    EXPECT_FALSE(viewport.GetClipFromCamera(xform));
    EXPECT_FALSE(viewport.GetScreenFromWorld(xform));
    EXPECT_FALSE(viewport.GetRay(1, 1, origin, direction));
    EXPECT_FALSE(viewport.GetRay(1, 1, line));
    EXPECT_EQ(xform, before);
    EXPECT_EQ(viewport.TargetDistance(), KM_UNSET_VALUE);
}

TEST(Projecting, CornerRaysOfAKnownOpening) {
    KM_3dPoint origin;
    KM_3dVector direction;
    ASSERT_TRUE(camera().GetRay(200, 0, origin, direction));
    EXPECT_EQ(origin, KM_3dPoint(10, 20, 30));
    EXPECT_LE((direction - KM_3dVector(0, std::sqrt(0.5), std::sqrt(0.5))).Length(), 1e-15);
    ASSERT_TRUE(camera().GetRay(400, 200, origin, direction));
    // Width, near and height of the lower right corner: (2, 1, -1)
    EXPECT_LE((direction - KM_3dVector(2, 1, -1) / std::sqrt(6.0)).Length(), 1e-15);
    EXPECT_FALSE(camera().GetRay(std::nan(""), 0, origin, direction));
}

TEST(Projecting, ParallelRaysLeaveThePlaneOfTheCamera) {
    KM_3dPoint origin;
    KM_3dVector direction;
    ASSERT_TRUE(camera(KM_parallel_view).GetRay(300, 50, origin, direction));
    EXPECT_EQ(origin, KM_3dPoint(11, 20, 30.5));
    EXPECT_EQ(direction, KM_3dVector::YAxis);
}

TEST(Projecting, TheRayBetweenThePlanesEndsOnThem) {
    KM_Line line;
    ASSERT_TRUE(camera().GetRay(400, 0, line));
    EXPECT_LE(line.from.DistanceTo(KM_3dPoint(12, 21, 31)), 1e-14);
    EXPECT_LE(line.to.DistanceTo(KM_3dPoint(212, 121, 131)), 1e-12);
}

TEST(Projecting, RaysGoThroughThePointsThatAreSeenThere) {
    std::mt19937 random(23);
    std::normal_distribution<double> coordinate(0.0, 30.0);
    for (const KM_ViewProjection projection : {KM_perspective_view, KM_parallel_view}) {
        KM_Viewport viewport;
        viewport.SetProjection(projection);
        int seen = 0;
        for (int i = 0; i < 300; ++i) {
            viewport.SetCameraDirection(
                {coordinate(random), coordinate(random), coordinate(random)});
            viewport.SetCameraUp({coordinate(random), coordinate(random), coordinate(random)});
            const KM_3dPoint point(coordinate(random), coordinate(random), coordinate(random));
            double x, y;
            if (!viewport.WorldToScreen(point, &x, &y, nullptr))
                continue;
            KM_3dPoint origin;
            KM_3dVector direction;
            ASSERT_TRUE(viewport.GetRay(x, y, origin, direction));
            EXPECT_NEAR(direction.Length(), 1.0, 1e-15);
            const KM_3dVector offset = point - origin;
            EXPECT_LE((offset - (offset * direction) * direction).Length(), 1e-11);
            ++seen;
        }
        EXPECT_GT(seen, 100);
    }
}

TEST(Projecting, WorldFromCameraCarriesTheFrame) {
    KM_Xform world_from_camera;
    ASSERT_TRUE(camera().GetWorldFromCamera(world_from_camera));
    EXPECT_EQ(world_from_camera * KM_3dPoint::Origin, KM_3dPoint(10, 20, 30));
    EXPECT_EQ(world_from_camera * KM_3dPoint(1, 2, -3), KM_3dPoint(11, 23, 32));
    KM_Xform camera_from_world;
    const KM_Viewport viewport;
    ASSERT_TRUE(viewport.GetWorldFromCamera(world_from_camera));
    ASSERT_TRUE(viewport.GetCameraFromWorld(camera_from_world));
    EXPECT_TRUE((camera_from_world * world_from_camera).IsIdentity(1e-13));
}

TEST(Projecting, FrustumCornersAreTheCornersOfTheCube) {
    for (const KM_ViewProjection projection : {KM_perspective_view, KM_parallel_view}) {
        KM_Viewport viewport = camera(projection);
        ASSERT_TRUE(viewport.SetFrustum(-1, 3, -2, 1, 1, 101));
        KM_Xform clip_from_camera;
        ASSERT_TRUE(viewport.GetClipFromCamera(clip_from_camera));
        const double spread = projection == KM_perspective_view ? 101 : 1;
        const KM_3dPoint near_corner = clip_from_camera * KM_3dPoint(-1, -2, -1);
        const KM_3dPoint far_corner = clip_from_camera * KM_3dPoint(3 * spread, spread, -101);
        EXPECT_LE(near_corner.DistanceTo(KM_3dPoint(-1, -1, -1)), 1e-14);
        EXPECT_LE(far_corner.DistanceTo(KM_3dPoint(1, 1, 1)), 1e-14);
    }
}

TEST(Projecting, ScreenMatrixAgreesWithWorldToScreen) {
    std::mt19937 random(29);
    std::normal_distribution<double> coordinate(0.0, 20.0);
    for (const KM_ViewProjection projection : {KM_perspective_view, KM_parallel_view}) {
        KM_Viewport viewport;
        viewport.SetProjection(projection);
        viewport.SetScreenPort(640, 480);
        KM_Xform screen_from_world;
        ASSERT_TRUE(viewport.GetScreenFromWorld(screen_from_world));
        for (int i = 0; i < 200; ++i) {
            const KM_3dPoint point(coordinate(random), coordinate(random), coordinate(random));
            double x = 0, y = 0;
            if (!viewport.WorldToScreen(point, &x, &y, nullptr))
                continue;
            const KM_3dPoint screen = screen_from_world * point;
            EXPECT_NEAR(screen.x, x, 1e-8);
            EXPECT_NEAR(screen.y, y, 1e-8);
        }
    }
}
