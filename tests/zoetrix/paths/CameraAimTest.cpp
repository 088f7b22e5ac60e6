#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/paths/ZoetrixDynamicAccess.h"

#include <cmath>
#include <limits>

namespace {

constexpr double tolerance = 1e-12;

class CameraAim : public PlugInFixture {
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

TEST_F(CameraAim, LevelCameraStaysLevel) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    ASSERT_TRUE(place({3.0, 4.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraLocation(), KM_3dPoint(0.0, 0.0, 0.0), 0.0));
    EXPECT_TRUE(near(placed.TargetPoint(), KM_3dPoint(3.0, 4.0, 0.0), 0.0));
    EXPECT_TRUE(near(placed.CameraZ(), KM_3dVector(-0.6, -0.8, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
}

TEST_F(CameraAim, FrameHasXToTheRightYUpAndZTowardTheCamera) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    // The direction is (0, 3, -4) / 5 = (0, 0.6, -0.8). X = direction x (0, 0, 1) / 0.6 = (1, 0,
    // 0); Z = (0, -0.6, 0.8); Y = Z x X = (0, 0.8, 0.6).
    ASSERT_TRUE(place({2.0, 3.0, 1.0}, {2.0, 0.0, 5.0}));
    EXPECT_TRUE(near(placed.CameraX(), KM_3dVector(1.0, 0.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.8, 0.6), tolerance));
    EXPECT_TRUE(near(placed.CameraZ(), KM_3dVector(0.0, -0.6, 0.8), tolerance));
    EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(0.0, 3.0, -4.0), 0.0));
}

TEST_F(CameraAim, WorldsZIsTheUpWhereItFits) {
    // Level, but tilted by 45 degrees: its own up is (0, 1, 1) / sqrt(2) and is not taken over.
    look({0.0, 1.0, -1.0}, {0.0, 1.0, 1.0});
    ASSERT_TRUE(place({3.0, 4.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.0, 0.0, 1.0), 0.0));
}

TEST_F(CameraAim, CoincidentAndInvalidPointsFailAndLeaveTheResultAlone) {
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

TEST_F(CameraAim, RefusedUpFailsAndLeavesTheResultAlone) {
    // Rolled by 30 degrees the up is that of the old camera; along it there is nothing to look at.
    lookRolled(KM_PI / 6.0);
    const KM_Viewport before = placed;
    EXPECT_FALSE(place(KM_3dPoint::Origin + 5.0 * viewport().VP().CameraY(), KM_3dPoint::Origin));
    EXPECT_TRUE(before == placed);
}

TEST_F(CameraAim, OffsetAboveTheTinyOneIsEnough) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    EXPECT_TRUE(place({0.0, 3e-10, 0.0}, KM_3dPoint::Origin));
}

TEST_F(CameraAim, RollOfThirtyDegreesIsKept) {
    const double roll = KM_PI / 6.0;
    for (const double signed_roll : {roll, -roll}) {
        lookRolled(signed_roll);
        // The same direction from another place: the camera's up must be the old one.
        ASSERT_TRUE(place({7.0, 9.0, 2.0}, {7.0, 4.0, 2.0}));
        EXPECT_TRUE(near(placed.CameraY(),
                         KM_3dVector(std::sin(signed_roll), 0.0, std::cos(signed_roll)), 1e-12));
    }
}

TEST_F(CameraAim, RollTurnsAboutTheOldLineOfSight) {
    lookRolled(KM_PI / 6.0);
    // World Z rolled about the old line of sight (Y) is (1/2, 0, sqrt(3)/2); the new direction is
    // X, and the picture's up is what of that vector is perpendicular to X.
    ASSERT_TRUE(place({5.0, 0.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.5, 0.0, std::sqrt(0.75)), 1e-12));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), 1e-12));
}

TEST_F(CameraAim, RollOfThirtyDegreesTiltsWorldsUpInTheNewPicture) {
    lookRolled(KM_PI / 6.0);
    // A new direction that is the old one tilted down: (0, 3, -4) / 5. World Z rolled about the old
    // line of sight, u = (1/2, 0, sqrt(3)/2), less its part along the direction, which is
    // u * d = -0.8 sqrt(3)/2: v = (1/2, 0.48 sqrt(3)/2, 0.36 sqrt(3)/2), of the length
    // sqrt(1/4 + 0.6^2 * 3/4) = sqrt(0.52).
    ASSERT_TRUE(place({0.0, 3.0, 0.0}, {0.0, 0.0, 4.0}));
    const double half_root_3 = std::sqrt(0.75);
    const KM_3dVector up(0.5, 0.48 * half_root_3, 0.36 * half_root_3);
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.5, 0.0, half_root_3), 1e-12));
    EXPECT_TRUE(near(placed.CameraY(), up / std::sqrt(0.52), 1e-12));
}

TEST_F(CameraAim, RollOfAMillionthIsNone) {
    for (const double none : {0.99e-6, -0.99e-6}) {
        lookRolled(none);
        ASSERT_TRUE(place({0.0, 5.0, 0.0}, {0.0, 0.0, 0.0}));
        EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.0, 0.0, 1.0), 0.0));
    }
    for (const double some : {1.01e-6, -1.01e-6}) {
        lookRolled(some);
        ASSERT_TRUE(place({0.0, 5.0, 0.0}, {0.0, 0.0, 0.0}));
        // The arc cosine of 1 - 5e-13 is good to about 1e-10.
        EXPECT_NEAR(placed.CameraUp().x, some, 1e-9);
    }
}

TEST_F(CameraAim, ARolledCameraThatTurnsStraightDownIsRolledFromItsOldUp) {
    lookRolled(KM_PI / 6.0);
    // World Z lies along the direction, so the old up is taken, 30 degrees from Z toward X, and
    // rolled by the 30 degrees that the old camera had: 60 degrees, (sqrt(3)/2, 0, 1/2). Seen
    // straight down, what is left of it is +X.
    ASSERT_TRUE(place({0.0, 0.0, 0.0}, {0.0, 0.0, 9.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(std::sqrt(0.75), 0.0, 0.5), 1e-12));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(1.0, 0.0, 0.0), 1e-12));
}

TEST_F(CameraAim, LookingStraightDownKeepsTheOldUp) {
    look({0.0, 0.0, -1.0}, {0.0, 1.0, 0.0});
    ASSERT_TRUE(place({5.0, 5.0, 0.0}, {5.0, 5.0, 9.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraZ(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
}

TEST_F(CameraAim, TurningStraightDownKeepsTheOldUpAsItIs) {
    // The camera looks down at 45 degrees; its up is (0, 1, 1) / sqrt(2). Turned as the direction
    // is, it would be (0, 1, 0); as it fits unturned, it stays.
    look({0.0, 1.0, -1.0}, {0.0, 0.0, 1.0});
    ASSERT_TRUE(place({0.0, 0.0, 0.0}, {0.0, 0.0, 9.0}));
    EXPECT_TRUE(
        near(placed.CameraUp(), KM_3dVector(0.0, std::sqrt(0.5), std::sqrt(0.5)), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
}

TEST_F(CameraAim, OldUpTurnsWithTheDirectionWhereItWouldLieAlongIt) {
    // A level camera that looks along +Y turns to look straight down: its up, Z, lies along the new
    // direction; turned as the direction was, about the X axis, it is +Y.
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    ASSERT_TRUE(place({0.0, 0.0, 0.0}, {0.0, 0.0, 25.0}));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 1.0, 0.0), tolerance));
    ASSERT_TRUE(place({0.0, 0.0, 25.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, -1.0, 0.0), tolerance));
}

TEST_F(CameraAim, LockedUpFlattensTheDirection) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0}, true);
    ASSERT_TRUE(place({3.0, 4.0, 5.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(3.0, 4.0, 0.0), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.0, 1.0), tolerance));
    EXPECT_TRUE(near(placed.TargetPoint(), KM_3dPoint(3.0, 4.0, 5.0), 0.0));
}

TEST_F(CameraAim, LockedUpThatIsNotTheWorldsStaysAndKeepsNoRoll) {
    // Up is (0, 0.6, 0.8) and the camera looks along (0, 0.8, -0.6). The way to the target,
    // (1, 0, 5), has 5 * 0.8 = 4 along the up: (1, 0, 5) - 4 (0, 0.6, 0.8) = (1, -2.4, 1.8).
    look({0.0, 0.8, -0.6}, {0.0, 0.6, 0.8}, true);
    ASSERT_TRUE(place({1.0, 0.0, 5.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(1.0, -2.4, 1.8), tolerance));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.0, 0.6, 0.8), tolerance));
    EXPECT_TRUE(near(placed.CameraUp(), KM_3dVector(0.0, 0.6, 0.8), tolerance));
    EXPECT_TRUE(placed.CameraUpIsLocked());
}

TEST_F(CameraAim, ARolledLockedUpStaysRolled) {
    look({0.0, 1.0, 0.0}, {0.5, 0.0, std::sqrt(0.75)}, true);
    ASSERT_TRUE(place({0.0, 7.0, 0.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(near(placed.CameraY(), KM_3dVector(0.5, 0.0, std::sqrt(0.75)), tolerance));
}

TEST_F(CameraAim, LockedUpKeepsTheOldDirectionTowardATargetAlongIt) {
    look({0.0, 2.0, 0.0}, {0.0, 0.0, 1.0}, true);
    // Straight along it, and so nearly that what is left in the plane counts as nothing.
    for (const double beside : {0.0, 1e-10}) {
        ASSERT_TRUE(place({beside, 0.0, 5.0}, {0.0, 0.0, 0.0}));
        EXPECT_TRUE(near(placed.CameraDirection(), KM_3dVector(0.0, 2.0, 0.0), 0.0));
        EXPECT_TRUE(near(placed.CameraLocation(), KM_3dPoint(0.0, 0.0, 0.0), 0.0));
    }
}

TEST_F(CameraAim, TheLiveViewportStaysAsItIs) {
    look({0.0, 1.0, 0.0}, {0.0, 0.0, 1.0});
    const KM_Viewport before = viewport().VP();
    ASSERT_TRUE(place({9.0, 9.0, 9.0}, {0.0, 0.0, 0.0}));
    EXPECT_TRUE(before == viewport().VP());
}
