#include "host/document/CameraMove.h"

namespace quarn {

namespace {

/// The old up after the turn that carries the old direction onto the new one.
KM_3dVector turnedUp(const KM_Viewport& old_viewport, const KM_3dVector& direction) {
    return KM_Xform::Rotation(-old_viewport.CameraZ(), direction, KM_3dPoint::Origin) *
           old_viewport.CameraY();
}

bool setUp(KM_Viewport& moved, const KM_Viewport& old_viewport, const KM_3dVector& direction,
           bool level_horizon) {
    if (moved.CameraUpIsLocked())
        return moved.IsValidCamera();
    if (level_horizon && moved.SetCameraUp(KM_3dVector::ZAxis))
        return true;
    if (!level_horizon && moved.SetCameraUp(old_viewport.CameraY()))
        return true;
    return moved.SetCameraUp(turnedUp(old_viewport, direction));
}

} // namespace

bool moveCamera(KM_Viewport& viewport, const KM_3dPoint& target, const KM_3dPoint& camera,
                bool level_horizon) {
    if (!target.IsValid() || !camera.IsValid())
        return false;
    const KM_3dVector direction = target - camera;
    if (!direction.IsValid() || direction.IsTiny())
        return false;

    KM_Viewport moved = viewport;
    if (!moved.SetCameraLocation(camera) || !moved.SetCameraDirection(direction) ||
        !setUp(moved, viewport, direction, level_horizon))
        return false;
    viewport = moved;
    return true;
}

bool setTargetAndCamera(KM_Viewport& viewport, const KM_3dPoint& target, const KM_3dPoint& camera,
                        bool update_target, bool update_up) {
    if (!moveCamera(viewport, target, camera, update_up))
        return false;
    if (update_target)
        viewport.SetTargetPoint(target);
    return true;
}

} // namespace quarn
