#include "kelmar/KM_Viewport.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace {

// A camera at the origin that looks along +Y with up along +Z.
KM_Viewport northward() {
    KM_Viewport viewport;
    viewport.SetCameraLocation(KM_3dPoint::Origin);
    viewport.SetCameraDirection(KM_3dVector(0, 5, 0));
    viewport.SetCameraUp(KM_3dVector(0, 0, 2));
    return viewport;
}

void expectFrameOf(const KM_Viewport& viewport) {
    EXPECT_NEAR(viewport.CameraX().Length(), 1.0, 1e-15);
    EXPECT_NEAR(viewport.CameraY().Length(), 1.0, 1e-15);
    EXPECT_NEAR(viewport.CameraZ().Length(), 1.0, 1e-15);
    const KM_3dVector cross = KM_CrossProduct(viewport.CameraX(), viewport.CameraY());
    EXPECT_LE((cross - viewport.CameraZ()).Length(), 1e-15);
    EXPECT_EQ(viewport.CameraZ().IsParallelTo(-viewport.CameraDirection(), 1e-7), 1);
    EXPECT_GT(viewport.CameraY() * viewport.CameraUp(), 0.0);
    EXPECT_NEAR(viewport.CameraX() * viewport.CameraUp(), 0.0,
                1e-15 * viewport.CameraUp().Length());
}

} // namespace

TEST(Viewport, NewOneLooksAtTheOriginWithALensOf50Millimetres) {
    const KM_Viewport viewport;
    EXPECT_TRUE(viewport.IsValidCamera());
    EXPECT_TRUE(viewport.IsPerspectiveProjection());
    EXPECT_EQ(viewport.CameraLocation(), KM_3dPoint(40, -60, 35));
    EXPECT_EQ(viewport.CameraDirection(), KM_3dVector(-40, 60, -35));
    EXPECT_EQ(viewport.CameraUp(), KM_3dVector::ZAxis);
    EXPECT_EQ(viewport.TargetPoint(), KM_3dPoint::Origin);
    EXPECT_NEAR(viewport.TargetDistance(), std::sqrt(40.0 * 40 + 60 * 60 + 35 * 35), 1e-13);
    EXPECT_NEAR(viewport.FrustumAspect(), 4.0 / 3.0, 1e-15);
    double lens = 0;
    ASSERT_TRUE(viewport.GetCamera35mmLensLength(&lens));
    EXPECT_NEAR(lens, 50.0, 1e-13);
    EXPECT_FALSE(viewport.CameraUpIsLocked() || viewport.CameraDirectionIsLocked() ||
                 viewport.CameraLocationIsLocked());
    expectFrameOf(viewport);
}

TEST(Viewport, FrameIsRightUpAndBackward) {
    const KM_Viewport viewport = northward();
    EXPECT_EQ(viewport.CameraX(), KM_3dVector::XAxis);
    EXPECT_EQ(viewport.CameraY(), KM_3dVector::ZAxis);
    EXPECT_EQ(viewport.CameraZ(), -KM_3dVector::YAxis);
    EXPECT_EQ(viewport.CameraDirection(), KM_3dVector(0, 5, 0)) << "with the length it was set";
    EXPECT_EQ(viewport.CameraUp(), KM_3dVector(0, 0, 2));
}

TEST(Viewport, FrameIsOrthonormalForEveryDirectionAndUp) {
    std::mt19937 random(17);
    std::normal_distribution<double> coordinate;
    const auto vector = [&] {
        return KM_3dVector(coordinate(random), coordinate(random), coordinate(random));
    };
    KM_Viewport viewport;
    for (int i = 0; i < 500; ++i) {
        ASSERT_TRUE(viewport.SetCameraDirection(vector()));
        ASSERT_TRUE(viewport.SetCameraUp(vector()));
        expectFrameOf(viewport);
    }
}

TEST(Viewport, UpThatIsZeroInvalidOrParallelIsRefused) {
    KM_Viewport viewport = northward();
    const KM_Viewport before = viewport;
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector()));
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector::UnsetVector));
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector(0, std::nan(""), 1)));
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector(0, 3, 0)));
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector(0, -1e9, 0)));
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector(0.9e-9, 1, 0))) << "sine 0.9e-9";
    EXPECT_EQ(viewport, before);
    EXPECT_TRUE(viewport.SetCameraUp(KM_3dVector(1.1e-9, 1, 0))) << "sine 1.1e-9";
    EXPECT_EQ(viewport.CameraY(), KM_3dVector::XAxis);
}

TEST(Viewport, UpMayBeOfAnyLength) {
    KM_Viewport viewport = northward();
    EXPECT_TRUE(viewport.SetCameraUp(KM_3dVector(1e-200, 0, 0)));
    EXPECT_EQ(viewport.CameraY(), KM_3dVector::XAxis);
}

TEST(Viewport, DirectionThatIsZeroOrInvalidIsRefused) {
    KM_Viewport viewport = northward();
    const KM_Viewport before = viewport;
    EXPECT_FALSE(viewport.SetCameraDirection(KM_3dVector()));
    EXPECT_FALSE(viewport.SetCameraDirection(KM_3dVector::UnsetVector));
    EXPECT_EQ(viewport, before);
}

TEST(Viewport, DirectionAlongUpWaitsForAnotherUp) {
    KM_Viewport viewport = northward();
    EXPECT_TRUE(viewport.SetCameraDirection(KM_3dVector(0, 0, -7)));
    EXPECT_EQ(viewport.CameraDirection(), KM_3dVector(0, 0, -7));
    EXPECT_FALSE(viewport.IsValidCamera());
    EXPECT_EQ(viewport.CameraZ(), -KM_3dVector::YAxis) << "the last frame that could be built";
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector::ZAxis));
    EXPECT_TRUE(viewport.SetCameraUp(KM_3dVector::YAxis));
    EXPECT_TRUE(viewport.IsValidCamera());
    EXPECT_EQ(viewport.CameraX(), KM_3dVector::XAxis);
    EXPECT_EQ(viewport.CameraY(), KM_3dVector::YAxis);
    EXPECT_EQ(viewport.CameraZ(), KM_3dVector::ZAxis);
}

TEST(Viewport, FrameReturnsWithADirectionThatUpAllows) {
    KM_Viewport viewport = northward();
    viewport.SetCameraDirection(KM_3dVector(0, 0, -1));
    EXPECT_FALSE(viewport.IsValidCamera());
    viewport.SetCameraDirection(KM_3dVector(1, 0, 0));
    EXPECT_TRUE(viewport.IsValidCamera());
    EXPECT_EQ(viewport.CameraX(), -KM_3dVector::YAxis);
}

TEST(Viewport, LockedPartsRefuseTheirSetters) {
    KM_Viewport viewport = northward();
    viewport.SetCameraLocationLock(true);
    EXPECT_FALSE(viewport.SetCameraLocation(KM_3dPoint(1, 1, 1)));
    EXPECT_EQ(viewport.CameraLocation(), KM_3dPoint::Origin);
    viewport.SetCameraDirectionLock(true);
    EXPECT_FALSE(viewport.SetCameraDirection(KM_3dVector(1, 0, 0)));
    EXPECT_EQ(viewport.CameraDirection(), KM_3dVector(0, 5, 0));
    viewport.SetCameraUpLock(true);
    EXPECT_FALSE(viewport.SetCameraUp(KM_3dVector(1, 0, 0)));
    EXPECT_EQ(viewport.CameraUp(), KM_3dVector(0, 0, 2));
    EXPECT_TRUE(viewport.CameraLocationIsLocked() && viewport.CameraDirectionIsLocked() &&
                viewport.CameraUpIsLocked());
    viewport.SetCameraLocationLock(false);
    EXPECT_TRUE(viewport.SetCameraLocation(KM_3dPoint(1, 1, 1)));
}

TEST(Viewport, LocationMustBeAPoint) {
    KM_Viewport viewport = northward();
    EXPECT_FALSE(viewport.SetCameraLocation(KM_3dPoint::UnsetPoint));
    EXPECT_FALSE(viewport.SetCameraLocation(KM_3dPoint(0, 0, INFINITY)));
    EXPECT_EQ(viewport.CameraLocation(), KM_3dPoint::Origin);
}

TEST(Viewport, TargetMayBeRemoved) {
    KM_Viewport viewport = northward();
    EXPECT_TRUE(viewport.SetTargetPoint(KM_3dPoint(3, 10, 4)));
    EXPECT_EQ(viewport.TargetDistance(), 10.0) << "along the view direction";
    EXPECT_TRUE(viewport.SetTargetPoint(KM_3dPoint(0, -2, 0)));
    EXPECT_EQ(viewport.TargetDistance(), -2.0) << "behind the camera";
    EXPECT_FALSE(viewport.SetTargetPoint(KM_3dPoint(0, std::nan(""), 0)));
    EXPECT_EQ(viewport.TargetPoint(), KM_3dPoint(0, -2, 0));
    EXPECT_TRUE(viewport.SetTargetPoint(KM_3dPoint::UnsetPoint));
    EXPECT_EQ(viewport.TargetPoint(), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(viewport.TargetDistance(), KM_UNSET_VALUE);
}

TEST(Viewport, UnsoundFrustumsAreRefused) {
    KM_Viewport viewport;
    const KM_Viewport before = viewport;
    EXPECT_FALSE(viewport.SetFrustum(1, 1, -1, 1, 1, 10));
    EXPECT_FALSE(viewport.SetFrustum(-1, 1, 1, -1, 1, 10));
    EXPECT_FALSE(viewport.SetFrustum(-1, 1, -1, 1, 10, 10));
    EXPECT_FALSE(viewport.SetFrustum(-1, 1, -1, 1, 0, 10)) << "perspective needs a near plane";
    EXPECT_FALSE(viewport.SetFrustum(-1, 1, -1, std::nan(""), 1, 10));
    EXPECT_FALSE(viewport.SetFrustumNearFar(-1, 10));
    EXPECT_FALSE(viewport.SetFrustumNearFar(10, 1));
    EXPECT_FALSE(viewport.SetFrustumNearFar(std::nan(""), 1));
    EXPECT_EQ(viewport, before);
    viewport.SetProjection(KM_parallel_view);
    EXPECT_TRUE(viewport.SetFrustum(-1, 1, -1, 1, -5, 10)) << "a parallel view may begin behind";
}

TEST(Viewport, ChangingTheProjectionKeepsTheOpeningWhereTheTargetIsTooFarToMeasure) {
    KM_Viewport viewport;
    viewport.SetCameraLocation({-1e308, 0.0, 0.0});
    viewport.SetCameraDirection({1.0, 0.0, 0.0});
    viewport.SetTargetPoint({1e307, 0.0, 0.0});
    ASSERT_TRUE(viewport.SetFrustumNearFar(1e-3, 10.0));
    const double aspect = viewport.FrustumAspect();
    EXPECT_TRUE(viewport.SetProjection(KM_parallel_view));
    EXPECT_TRUE(viewport.IsParallelProjection());
    EXPECT_DOUBLE_EQ(viewport.FrustumAspect(), aspect);
    EXPECT_TRUE(viewport.SetScreenPort(640, 480));
}

TEST(Viewport, MovingThePlanesKeepsThePerspectiveOpening) {
    KM_Viewport viewport;
    ASSERT_TRUE(viewport.SetFrustum(-1, 2, -1, 1, 1, 100));
    ASSERT_TRUE(viewport.SetFrustumNearFar(4, 50));
    double l, r, b, t, n, f;
    ASSERT_TRUE(viewport.GetFrustum(&l, &r, &b, &t, &n, &f));
    EXPECT_EQ(l, -4.0);
    EXPECT_EQ(r, 8.0);
    EXPECT_EQ(b, -4.0);
    EXPECT_EQ(t, 4.0);
    EXPECT_EQ(n, 4.0);
    EXPECT_EQ(f, 50.0);
    EXPECT_TRUE(viewport.GetFrustum(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr));
}

TEST(Viewport, HalfAnglesComeFromWidthHeightAndNear) {
    KM_Viewport viewport;
    ASSERT_TRUE(viewport.SetFrustum(-std::sqrt(3.0), std::sqrt(3.0), -1, 1, 1, 100));
    double vertical = 0, horizontal = 0;
    ASSERT_TRUE(viewport.GetCameraHalfAngles(&vertical, &horizontal));
    EXPECT_NEAR(vertical, KM_PI / 4, 1e-15);
    EXPECT_NEAR(horizontal, KM_PI / 3, 1e-15);
    viewport.SetProjection(KM_parallel_view);
    EXPECT_FALSE(viewport.GetCameraHalfAngles(&vertical, &horizontal));
}

TEST(Viewport, AspectKeepsTheSmallerHalfAngle) {
    KM_Viewport viewport;
    double vertical = 0, horizontal = 0;
    ASSERT_TRUE(viewport.SetFrustumAspect(2.0));
    viewport.GetCameraHalfAngles(&vertical, &horizontal);
    EXPECT_NEAR(std::tan(vertical), 12.0 / 50.0, 1e-15);
    EXPECT_NEAR(std::tan(horizontal), 2 * 12.0 / 50.0, 1e-15);
    ASSERT_TRUE(viewport.SetFrustumAspect(0.5));
    viewport.GetCameraHalfAngles(&vertical, &horizontal);
    EXPECT_NEAR(std::tan(horizontal), 12.0 / 50.0, 1e-15);
    EXPECT_NEAR(std::tan(vertical), 2 * 12.0 / 50.0, 1e-15);
    EXPECT_NEAR(viewport.FrustumAspect(), 0.5, 1e-15);
    for (const double bad : {0.0, -1.0, std::nan(""), double(INFINITY)})
        EXPECT_FALSE(viewport.SetFrustumAspect(bad));
}

TEST(Viewport, LensLengthFillsTheSmallerSideWith24Millimetres) {
    KM_Viewport viewport;
    double lens = 0, vertical = 0, horizontal = 0;
    ASSERT_TRUE(viewport.SetCamera35mmLensLength(24.0));
    viewport.GetCameraHalfAngles(&vertical, &horizontal);
    EXPECT_NEAR(vertical, std::atan(0.5), 1e-15) << "the picture is wider than high";
    EXPECT_NEAR(viewport.FrustumAspect(), 4.0 / 3.0, 1e-15);
    ASSERT_TRUE(viewport.SetScreenPort(300, 900));
    ASSERT_TRUE(viewport.SetCamera35mmLensLength(12.0));
    viewport.GetCameraHalfAngles(&vertical, &horizontal);
    EXPECT_NEAR(horizontal, KM_PI / 4, 1e-15) << "and here higher than wide";
    ASSERT_TRUE(viewport.GetCamera35mmLensLength(&lens));
    EXPECT_NEAR(lens, 12.0, 1e-13);
    EXPECT_FALSE(viewport.SetCamera35mmLensLength(0.0));
    viewport.SetProjection(KM_parallel_view);
    EXPECT_FALSE(viewport.SetCamera35mmLensLength(50.0));
    EXPECT_FALSE(viewport.GetCamera35mmLensLength(&lens));
}

TEST(Viewport, ScreenSizeGivesTheFrustumItsAspect) {
    KM_Viewport viewport;
    ASSERT_TRUE(viewport.SetScreenPort(1280, 720));
    int width = 0, height = 0;
    viewport.GetScreenPort(&width, &height);
    EXPECT_EQ(width, 1280);
    EXPECT_EQ(height, 720);
    EXPECT_NEAR(viewport.FrustumAspect(), 16.0 / 9.0, 1e-15);
    EXPECT_FALSE(viewport.SetScreenPort(0, 720));
    EXPECT_FALSE(viewport.SetScreenPort(1280, -1));
    viewport.GetScreenPort(&width, nullptr);
    EXPECT_EQ(width, 1280);
}

TEST(Viewport, ChangingTheProjectionKeepsTheSizeAtTheTarget) {
    KM_Viewport viewport = northward();
    viewport.SetTargetPoint(KM_3dPoint(0, 50, 0));
    const KM_3dPoint beside(3, 50, 2);
    double x = 0, y = 0, parallel_x = 0, parallel_y = 0;
    ASSERT_TRUE(viewport.WorldToScreen(beside, &x, &y, nullptr));
    ASSERT_TRUE(viewport.SetProjection(KM_parallel_view));
    EXPECT_TRUE(viewport.IsParallelProjection());
    ASSERT_TRUE(viewport.WorldToScreen(beside, &parallel_x, &parallel_y, nullptr));
    EXPECT_NEAR(parallel_x, x, 1e-10);
    EXPECT_NEAR(parallel_y, y, 1e-10);
    viewport.SetProjection(KM_perspective_view);
    ASSERT_TRUE(viewport.WorldToScreen(beside, &parallel_x, &parallel_y, nullptr));
    EXPECT_NEAR(parallel_x, x, 1e-10);
    EXPECT_FALSE(viewport.SetProjection(static_cast<KM_ViewProjection>(0)));
    EXPECT_TRUE(viewport.IsPerspectiveProjection());
}

TEST(Viewport, PerspectiveGetsANearPlaneInFrontOfTheCamera) {
    KM_Viewport viewport;
    viewport.SetProjection(KM_parallel_view);
    ASSERT_TRUE(viewport.SetFrustum(-4, 4, -3, 3, -20, -10));
    ASSERT_TRUE(viewport.SetProjection(KM_perspective_view));
    double n = 0, f = 0;
    viewport.GetFrustum(nullptr, nullptr, nullptr, nullptr, &n, &f);
    EXPECT_GT(n, 0.0);
    EXPECT_GT(f, n);
}

TEST(Viewport, CopiesAreEqualUntilOneIsChanged) {
    const KM_Viewport viewport = northward();
    KM_Viewport copy;
    EXPECT_FALSE(copy == viewport);
    copy = viewport;
    EXPECT_EQ(copy, viewport);
    copy.SetCameraUpLock(true);
    EXPECT_FALSE(copy == viewport);
}
