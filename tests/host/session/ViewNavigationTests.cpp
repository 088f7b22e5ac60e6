#include "host/session/ViewNavigation.h"

#include "host/session/ViewFrame.h"
#include "tests/host/document/DocumentFixtures.h"

#include <cmath>
#include <limits>
#include <numbers>

namespace quarn::test {
namespace {

constexpr int WIDTH_PX = 800;
constexpr int HEIGHT_PX = 600;

class ViewNavigationTest : public DocumentTest {
protected:
    void SetUp() override {
        for (const auto& each : document.views())
            ASSERT_TRUE(setFrameSize(each->face(), WIDTH_PX, HEIGHT_PX));
    }

    /// Looks at a target from its side, `direction` from the target to the camera.
    void look(ViewState& at, const KM_3dPoint& target, const KM_3dVector& direction) {
        ASSERT_TRUE(at.setTargetAndCamera(target, target + direction, true, true));
    }

    ViewState& named(const wchar_t* name) { return *document.findView(name); }
};

/// Checks the place of the picture where a point is seen.
void expectSeenAt(const ViewState& view, const KM_3dPoint& point, double x_px, double y_px,
                  double tolerance) {
    double x = 0.0;
    double y = 0.0;
    ASSERT_TRUE(view.viewport().WorldToScreen(point, &x, &y, nullptr));
    EXPECT_NEAR(x, x_px, tolerance);
    EXPECT_NEAR(y, y_px, tolerance);
}

/// The point that is seen at a place of the picture, on the plane of the target across the view.
KM_3dPoint atTargetDepth(const ViewState& view, double x_px, double y_px) {
    KM_3dPoint origin;
    KM_3dVector direction;
    const KM_Viewport& camera = view.viewport();
    EXPECT_TRUE(camera.GetRay(x_px, y_px, origin, direction));
    const double along = -(direction * camera.CameraZ());
    const double depth = (origin - camera.TargetPoint()) * camera.CameraZ();
    return origin + (depth / along) * direction;
}

void expectNear(const KM_3dPoint& point, const KM_3dPoint& expected, double tolerance) {
    EXPECT_NEAR(point.x, expected.x, tolerance);
    EXPECT_NEAR(point.y, expected.y, tolerance);
    EXPECT_NEAR(point.z, expected.z, tolerance);
}

// ---- Orbiting

TEST_F(ViewNavigationTest, HalfTheWidthTurnsTheCameraAQuarterAgainstTheMouse) {
    look(view, {1.0, 2.0, 3.0}, {0.0, -10.0, 0.0});
    orbitView(view.face(), WIDTH_PX / 2.0, 0.0);
    // The side that faced the camera goes to the right with the mouse, so the camera goes left.
    expectNear(view.viewport().CameraLocation(), {-9.0, 2.0, 3.0}, 1e-12);
    expectNear(view.viewport().TargetPoint(), {1.0, 2.0, 3.0}, 0.0);
    EXPECT_NEAR(view.viewport().CameraY().z, 1.0, 1e-12);
}

TEST_F(ViewNavigationTest, ASixthOfTheHeightRaisesTheCameraByThirtyDegrees) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -10.0, 0.0});
    orbitView(view.face(), 0.0, HEIGHT_PX / 6.0);
    expectNear(view.viewport().CameraLocation(), {0.0, -5.0 * std::sqrt(3.0), 5.0}, 1e-12);
    EXPECT_NEAR(view.viewport().CameraX().z, 0.0, 1e-15) << "the horizon is level";
}

TEST_F(ViewNavigationTest, TheCameraStopsShortOfTheVerticalAboveAndBelow) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -10.0, 0.0});
    const double highest = 10.0 * std::sin(89.9 / 180.0 * std::numbers::pi);
    orbitView(view.face(), 0.0, 5000.0);
    EXPECT_NEAR(view.viewport().CameraLocation().z, highest, 1e-9);
    EXPECT_LT(view.viewport().CameraLocation().y, 0.0) << "not over the top";
    orbitView(view.face(), 0.0, -50000.0);
    EXPECT_NEAR(view.viewport().CameraLocation().z, -highest, 1e-9);
    EXPECT_GT(view.viewport().CameraY().z, 0.0);
}

TEST_F(ViewNavigationTest, FromStraightAboveTheTurnBeginsWhereThePictureStands) {
    KM_Viewport camera = view.viewport();
    ASSERT_TRUE(camera.SetCameraLocation({0.0, 0.0, 10.0}));
    ASSERT_TRUE(camera.SetCameraDirection({0.0, 0.0, -10.0}));
    ASSERT_TRUE(camera.SetCameraUp({1.0, 0.0, 0.0}));
    ASSERT_TRUE(camera.SetTargetPoint({0.0, 0.0, 0.0}));
    ASSERT_TRUE(view.setViewport(camera, true, true));
    orbitView(view.face(), 0.0, -HEIGHT_PX / 4.0); // 45 degrees, from the pole
    const double side = 10.0 * std::sqrt(0.5);
    expectNear(view.viewport().CameraLocation(), {-side, 0.0, side}, 1e-9);
}

TEST_F(ViewNavigationTest, AThousandSmallTurnsAreOneAndKeepTheDistanceFarFromTheOrigin) {
    const KM_3dPoint target(1.0e7, -1.0e7, 100.0);
    look(view, target, {0.0, -20.0, 0.0});
    for (int i = 0; i < 1000; ++i)
        orbitView(view.face(), 0.4, 0.0);
    expectNear(view.viewport().CameraLocation(), {1.0e7 - 20.0, -1.0e7, 100.0}, 1e-4);
    EXPECT_NEAR(view.viewport().CameraLocation().DistanceTo(target), 20.0, 1e-4);
}

TEST_F(ViewNavigationTest, ATargetBesideThePicturesMiddleDoesNotMakeItJump) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -10.0, 0.0});
    KM_Viewport camera = view.viewport();
    ASSERT_TRUE(camera.SetTargetPoint({3.0, 0.0, 0.0}));
    ASSERT_TRUE(view.setViewport(camera, true, true));
    orbitView(view.face(), 0.0, 0.0);
    expectNear(view.viewport().CameraLocation(), {0.0, -10.0, 0.0}, 1e-12);
    expectSeenAt(view, {0.0, 0.0, 0.0}, WIDTH_PX / 2.0, HEIGHT_PX / 2.0, 1e-9);
}

TEST_F(ViewNavigationTest, APlanViewIsMovedInsteadOfTurned) {
    for (const wchar_t* name : {L"Top", L"Front", L"Right"}) {
        ViewState& plan = named(name);
        const KM_3dVector direction = plan.viewport().CameraZ();
        const KM_3dPoint under_mouse = atTargetDepth(plan, 300.0, 200.0);
        orbitView(plan.face(), 50.0, -20.0);
        EXPECT_EQ(plan.viewport().CameraZ(), direction);
        expectSeenAt(plan, under_mouse, 350.0, 180.0, 1e-9);
    }
}

TEST_F(ViewNavigationTest, AParallelViewAlongNoAxisIsTurned) {
    ViewState& plan = named(L"Front");
    look(plan, {0.0, 0.0, 0.0}, {3.0, -4.0, 1.0});
    orbitView(plan.face(), WIDTH_PX / 2.0, 0.0);
    expectNear(plan.viewport().CameraLocation(), {-4.0, -3.0, 1.0}, 1e-12);
}

// ---- Panning

TEST_F(ViewNavigationTest, WhatIsAtTheTargetsDepthStaysUnderTheMouse) {
    for (const auto& each : document.views()) {
        const KM_3dPoint under_mouse = atTargetDepth(*each, 123.0, 456.0);
        const KM_3dVector to_target =
            each->viewport().TargetPoint() - each->viewport().CameraLocation();
        panView(each->face(), 77.0, -33.0);
        expectSeenAt(*each, under_mouse, 200.0, 423.0, 1e-9);
        expectNear(each->viewport().CameraLocation() + to_target, each->viewport().TargetPoint(),
                   1e-12);
    }
}

TEST_F(ViewNavigationTest, FarFromTheOriginThePointStaysUnderTheMouseToAThousandthOfAPixel) {
    look(view, {1.0e7, 1.0e7, 0.0}, {0.0, -50.0, 30.0});
    const KM_3dPoint under_mouse = atTargetDepth(view, 123.0, 456.0);
    panView(view.face(), 77.0, -33.0);
    expectSeenAt(view, under_mouse, 200.0, 423.0, 1e-3);
}

// ---- Zooming

TEST_F(ViewNavigationTest, TheMousesPointStaysAndTheTargetComesNearerByTheFactor) {
    look(view, {1.0, 2.0, 3.0}, {5.0, -8.0, 4.0});
    const double distance = view.viewport().TargetDistance();
    const KM_3dPoint under_mouse = atTargetDepth(view, 650.0, 100.0);
    zoomView(view.face(), 2.5, 650.0, 100.0);
    expectSeenAt(view, under_mouse, 650.0, 100.0, 1e-9);
    EXPECT_NEAR(view.viewport().TargetDistance(), distance / 2.5, 1e-12);
    expectSeenAt(view, view.viewport().TargetPoint(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0, 1e-9);
    zoomView(view.face(), 1.0 / 2.5, 650.0, 100.0);
    expectNear(view.viewport().CameraLocation(), {6.0, -6.0, 7.0}, 1e-12);
}

TEST_F(ViewNavigationTest, AParallelPictureIsEnlargedAboutTheMouse) {
    ViewState& plan = named(L"Top");
    double left = 0.0;
    double right = 0.0;
    plan.viewport().GetFrustum(&left, &right, nullptr, nullptr, nullptr, nullptr);
    const KM_3dPoint under_mouse = atTargetDepth(plan, 10.0, 590.0);
    zoomView(plan.face(), 4.0, 10.0, 590.0);
    expectSeenAt(plan, under_mouse, 10.0, 590.0, 1e-9);
    double new_left = 0.0;
    double new_right = 0.0;
    plan.viewport().GetFrustum(&new_left, &new_right, nullptr, nullptr, nullptr, nullptr);
    EXPECT_NEAR(new_right - new_left, (right - left) / 4.0, 1e-12);
}

TEST_F(ViewNavigationTest, ClippingPlanesFollowTheCamera) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -80.0, 0.0});
    double near_distance = 0.0;
    double far_distance = 0.0;
    double angle = 0.0;
    double new_angle = 0.0;
    view.viewport().GetCameraHalfAngles(&angle, nullptr);
    zoomView(view.face(), 100.0, 400.0, 300.0); // to 0.8
    view.viewport().GetFrustum(nullptr, nullptr, nullptr, nullptr, &near_distance, &far_distance);
    EXPECT_NEAR(near_distance, 0.0008, 1e-12);
    EXPECT_GE(far_distance, 8000.0) << "what was seen is not cut off";
    view.viewport().GetCameraHalfAngles(&new_angle, nullptr);
    EXPECT_NEAR(new_angle, angle, 1e-12) << "the lens stays";
    zoomView(view.face(), 1e-5, 400.0, 300.0); // to 80000
    view.viewport().GetFrustum(nullptr, nullptr, nullptr, nullptr, &near_distance, &far_distance);
    EXPECT_NEAR(near_distance, 80.0, 1e-8);
    EXPECT_NEAR(far_distance, 8.0e6, 1e-3);
}

TEST_F(ViewNavigationTest, ZoomingEndsWhereACameraKeepsItsDigits) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -80.0, 0.0});
    zoomView(view.face(), 1e300, 400.0, 300.0);
    EXPECT_NEAR(view.viewport().TargetDistance(), 1e-9, 1e-12);
    EXPECT_TRUE(view.viewport().IsValidCamera());
    zoomView(view.face(), 1e-300, 400.0, 300.0);
    EXPECT_NEAR(view.viewport().TargetDistance(), 1e12, 1.0);
    look(view, {1.0e7, 0.0, 0.0}, {0.0, -80.0, 0.0});
    zoomView(view.face(), 1e300, 400.0, 300.0);
    EXPECT_NEAR(view.viewport().TargetDistance(), 1.0, 1e-6); // a ten-millionth of 1e7
    orbitView(view.face(), 100.0, 50.0);
    EXPECT_TRUE(view.viewport().IsValidCamera());
}

TEST_F(ViewNavigationTest, WhatIsNoFactorAndNoDistanceDoesNothing) {
    const KM_Viewport before = view.viewport();
    constexpr double NOT_A_NUMBER = std::numeric_limits<double>::quiet_NaN();
    constexpr double INFINITE = std::numeric_limits<double>::infinity();
    for (const double factor : {0.0, -2.0, NOT_A_NUMBER, INFINITE})
        zoomView(view.face(), factor, 10.0, 10.0);
    zoomView(view.face(), 2.0, NOT_A_NUMBER, 10.0);
    orbitView(view.face(), INFINITE, 0.0);
    orbitView(view.face(), 0.0, NOT_A_NUMBER);
    panView(view.face(), NOT_A_NUMBER, 0.0);
    panView(view.face(), 0.0, INFINITE);
    EXPECT_TRUE(view.viewport() == before);
}

TEST_F(ViewNavigationTest, ALockedCameraStays) {
    KM_Viewport locked = view.viewport();
    locked.SetCameraLocationLock(true);
    ASSERT_TRUE(view.setViewport(locked, true, true));
    const KM_Viewport before = view.viewport();
    orbitView(view.face(), 10.0, 10.0);
    panView(view.face(), 10.0, 10.0);
    zoomView(view.face(), 2.0, 10.0, 10.0);
    EXPECT_TRUE(view.viewport() == before);
}

TEST_F(ViewNavigationTest, NothingIsDrawnAndAClosedViewIsLeftAlone) {
    orbitView(view.face(), 10.0, 10.0);
    panView(view.face(), 10.0, 10.0);
    zoomView(view.face(), 2.0, 10.0, 10.0);
    EXPECT_EQ(view.drawCount(), 0U);
    ASSERT_TRUE(document.closeView(L"Perspective"));
    const KM_Viewport before = view.viewport();
    orbitView(view.face(), 10.0, 10.0);
    panView(view.face(), 10.0, 10.0);
    zoomView(view.face(), 2.0, 10.0, 10.0);
    EXPECT_TRUE(view.viewport() == before);
}

} // namespace
} // namespace quarn::test
