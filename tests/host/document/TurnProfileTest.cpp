#include "host/document/TurnProfile.h"

#include <cmath>
#include <gtest/gtest.h>

namespace quarn {
namespace {

/// How far above the target the middle lies of a cone's rim and a wall whose points are all as far
/// from the vertical, but for rounding.
double riseOfMiddle(const KM_3dPoint& target) {
    TurnProfile profile(target, target.z - 1.0, target.z + 1.0);
    for (int i = 0; i < 200; ++i) {
        const double angle = 0.1 * i;
        const double height = 0.99 + 0.00004 * ((37 * i) % 200); // within one of the rings
        profile.add(target + KM_3dVector(3.0 * std::cos(angle), 3.0 * std::sin(angle), height));
    }
    profile.add(target + KM_3dVector(0.5, 0.0, -1.0));
    KM_Viewport camera;
    camera.SetProjection(KM_perspective_view);
    camera.SetCameraLocation(target + KM_3dVector(0.0, -20.0, 5.0));
    camera.SetCameraDirection(KM_3dVector(0.0, -1.0, -0.25));
    camera.SetCameraUp(KM_3dVector::ZAxis);
    return profile.middle(camera).z - target.z;
}

TEST(TurnProfile, IsTheSameWhereverTheModelStands) {
    const double here = riseOfMiddle(KM_3dPoint::Origin);
    ASSERT_GT(std::abs(here), 0.01);
    EXPECT_NEAR(riseOfMiddle({4.5e6, 5.2e6, 100.0}), here, 1e-6);
    EXPECT_NEAR(riseOfMiddle({-31.7, 12.9, 0.1}), here, 1e-6);
}

} // namespace
} // namespace quarn
