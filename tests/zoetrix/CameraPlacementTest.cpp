#include "tests/zoetrix/PlugInFixture.h"
#include "zoetrix/paths/ZoetrixDynamicAccess.h"

#include <cmath>
#include <limits>

namespace {

constexpr double tolerance = 1e-12;

class CameraPlacement : public PlugInFixture {
protected:
    CQuarnViewport& viewport() { return view(L"Perspective").MainViewport(); }

    /// Gives the view a camera that looks along `direction` with this up.
    void look(const KM_3dVector& direction, const KM_3dVector& up, bool lock_up = false) {
        KM_Viewport camera = viewport().VP();
        // Up and direction may be parallel for a moment whichever is set first.
        camera.SetCameraDirection(KM_3dVector(1.0, 2.0, 3.0));
        ASSERT_TRUE(camera.SetCameraUp(KM_3dVector(3.0, 0.0, -1.0)));
        ASSERT_TRUE(camera.SetCameraDirection(direction));
        ASSERT_TRUE(camera.SetCameraUp(up));
        camera.SetCameraUpLock(lock_up);
        ASSERT_TRUE(viewport().SetVP(camera, true, true));
        ASSERT_LT(KM_CrossProduct(viewport().VP().CameraZ(), -direction).Length(), 1e-12);
    }

    /// Gives the view a level camera that looks along +Y, rolled about its line of sight.
    void lookRolled(double roll) { look({0.0, 1.0, 0.0}, {std::sin(roll), 0.0, std::cos(roll)}); }

    bool place(const KM_3dPoint& target, const KM_3dPoint& camera) {
        return SetTargetAndCameraLocation(viewport(), target, camera, placed);
    }

    KM_Viewport placed;
};

} // namespace

TEST_F(CameraPlacement, LevelCameraStaysLevel) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    ASSERT_TRUE(place({3.0, 4.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraLocation(), KM_3dPoint(0.0, 0.0, 0.0), 0.0));
    EXPECT_TRUE(near(placed.TargetPoint(), KM_3dPoint(3.0, 4.0, 0.0), 0.0));
    EXPECT_TRUE(near(placed.CameraZ(), KM_3dVector(-0.6, -0.8, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
}

TEST_F(CameraPlacement, CoincidentAndInvalidPointsFailAndLeaveTheResultAlone) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const KM_Viewport before = placed;
    const KM_3dPoint here(1.0, 2.0, 3.0);
    EXPECT_FALSE(place(here, here));
    EXPECT_FALSE(place({1e-10, -1e-10, 2e-10}, KM_3dPoint::Origin));
    EXPECT_FALSE(place(KM_3dPoint::UnsetPoint, here));
    EXPECT_FALSE(place(here, {nan, 0.0, 0.0}));
    EXPECT_FALSE(place({1e308, 0.0, 0.0}, {-1e308, 0.0, 0.0}));
    EXPECT_TRUE(before == placed);
}

TEST_F(CameraPlacement, OffsetAboveTheTinyOneIsEnough) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    EXPECT_TRUE(place({0.0, 3e-10, 0.0}, KM_3dPoint::Origin));
}

TEST_F(CameraPlacement, RollOfThirtyDegreesIsKept) {
    const double roll = KM_PI / 6.0;
    for (const double signed_roll : {roll, -roll}) {
        lookRolled(signed_roll);
        // The same direction from another place: the camera's up must be the old one.
        ASSERT_TRUE(place({7.0, 9.0, 2.0}, {7.0, 4.0, 2.0}));
        EXPECT_TRUE(near(placed.CameraY(),
                         KM_3dVector(std::sin(signed_roll), 0.0, std::cos(signed_roll)), 1e-12));
    }
}

TEST_F(CameraPlacement, RollTurnsAboutTheOldLineOfSight) {
    lookRolled(KM_PI / 6.0);
    // World Z rolled about the old line of sight (Y) is (1/2, 0, sqrt(3)/2); the new direction is
    // X, and the picture's up is what of that vector is perpendicular to X.
    ASSERT_TRUE(place({5.0, 0.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.5, 0.0, std::sqrt(0.75)), 1e-12));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), 1e-12));
}

TEST_F(CameraPlacement, RollOfAMillionthIsNone) {
    lookRolled(0.9e-6);
    ASSERT_TRUE(place({0.0, 5.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.0, 0.0, 1.0), 0.0));
    lookRolled(1e-5);
    ASSERT_TRUE(place({0.0, 5.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_GT(std::fabs(placed.CameraUp().x), 0.9e-5);
}

TEST_F(CameraPlacement, LookingStraightDownKeepsTheOldUp) {
    look({0.0, 0.0, -1.0}, {0.0, 1.0, 0.0});
    ASSERT_TRUE(place({5.0, 5.0, 0.0}, {5.0, 5.0, 9.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraZ(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
}

TEST_F(CameraPlacement, OldUpTurnsWithTheDirectionWhereItWouldLieAlongIt) {
    // A level camera that looks along +Y turns to look straight down: its up, Z, lies along the new
    // direction; turned as the direction was, about the X axis, it is +Y.
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    ASSERT_TRUE(place({0.0, 0.0, 0.0}, {0.0, 0.0, 25.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
    ASSERT_TRUE(place({0.0, 0.0, 25.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, -1.0, 0.0), tolerance));
}

TEST_F(CameraPlacement, LockedUpFlattensTheDirection) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0}, true);
    ASSERT_TRUE(place({3.0, 4.0, 5.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(3.0, 4.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
    EXPECT_TRUE(near(placed.TargetPoint(), KM_3dPoint(3.0, 4.0, 5.0), 0.0));
}

TEST_F(CameraPlacement, LockedUpKeepsTheOldDirectionTowardATargetAlongIt) {
    look({0.0, 2.0, 0.0}, {0.0, 0.0, 1.0}, true);
    ASSERT_TRUE(place({0.0, 0.0, 5.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(0.0, 2.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraLocation(), KM_3dPoint(0.0, 0.0, 0.0), 0.0));
}

TEST_F(CameraPlacement, TheLiveViewportStaysAsItIs) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    const KM_Viewport before = viewport().VP();
    ASSERT_TRUE(place({9.0, 9.0, 9.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(before == viewport().VP());
}
