#include "sdk/qncore/QnView.h"
#include "zoetrix/paths/ZoetrixDynamicAccess.h"

#include <algorithm>
#include <cmath>

namespace {

/// Rolls of at most this many radians count as none.
constexpr double smallest_roll = 1e-6;

bool IsUsable(const KM_3dVector& direction) {
    return direction.IsValid() && !direction.IsTiny(KM_ZERO_TOLERANCE);
}

/// The direction laid into the plane perpendicular to a locked up; the camera's present direction
/// when nothing is left of it.
KM_3dVector FlattenedDirection(const KM_3dVector& direction, const KM_Viewport& viewport) {
    const KM_3dVector up = viewport.CameraY();
    const KM_3dVector flat = direction - (direction * up) * up;
    return IsUsable(flat) ? flat : viewport.CameraDirection();
}

/// How far the camera is turned about its line of sight, in radians from the world's up as seen in
/// its picture; 0 when it looks along the world's up.
double RollFromWorldUp(const KM_Viewport& viewport) {
    const KM_3dVector up = KM_3dVector::ZAxis;
    KM_3dVector up_in_picture = up - (up * viewport.CameraZ()) * viewport.CameraZ();
    if (!up_in_picture.Unitize())
        return 0.0;
    const double roll = std::acos(std::clamp(up_in_picture * viewport.CameraY(), -1.0, 1.0));
    return up_in_picture * viewport.CameraX() < 0.0 ? -roll : roll;
}

/// The camera's direction and up before it was moved.
struct OldCamera {
    KM_3dVector direction;
    KM_3dVector up;
};

/// Gives the viewport, whose direction is set, the first up that it takes: the world's, the old
/// one, or the old one turned as the direction was.
/// @param up  receives it
bool SetFittingUp(KM_Viewport& viewport, const OldCamera& old, const KM_3dVector& direction,
                  KM_3dVector& up) {
    up = KM_3dVector::ZAxis;
    if (viewport.SetCameraUp(up))
        return true;
    up = old.up;
    if (viewport.SetCameraUp(up))
        return true;
    const KM_3dVector axis = KM_CrossProduct(old.direction, direction);
    up = KM_Xform::Rotation(axis.Length(), old.direction * direction, axis, KM_3dPoint::Origin) *
         old.up;
    return viewport.SetCameraUp(up);
}

} // namespace

bool SetTargetAndCameraLocation(const CQuarnViewport& view_vp, KM_3dPoint target, KM_3dPoint camera,
                                KM_Viewport& out) {
    if (!target.IsValid() || !camera.IsValid())
        return false;
    KM_3dVector direction = target - camera;
    if (!IsUsable(direction))
        return false;

    KM_Viewport viewport = view_vp.VP();
    const OldCamera old{-viewport.CameraZ(), viewport.CameraY()};
    const bool up_is_locked = viewport.CameraUpIsLocked();
    if (up_is_locked)
        direction = FlattenedDirection(direction, viewport);
    const double roll = up_is_locked ? 0.0 : RollFromWorldUp(viewport);

    viewport.SetCameraLocation(camera);
    viewport.SetCameraDirection(direction);
    if (!up_is_locked) {
        KM_3dVector up;
        if (!SetFittingUp(viewport, old, direction, up))
            return false;
        // The roll turns about the old line of sight, not the new one.
        if (std::fabs(roll) > smallest_roll) {
            up = KM_Xform::Rotation(roll, -old.direction, camera) * up;
            if (!viewport.SetCameraUp(up))
                return false;
        }
    }
    viewport.SetTargetPoint(target);
    out = viewport;
    return true;
}
