#include "ground/ViewportLayout.h"

#include "ground/Fields.h"

namespace quarn {

namespace {

/// The parts of a viewport that its other parts follow from.
struct Parts {
    KM_ViewProjection projection = KM_perspective_view;
    KM_3dPoint location;
    KM_3dVector direction;
    KM_3dVector up;
    KM_3dPoint target;
    bool location_locked = false;
    bool direction_locked = false;
    bool up_locked = false;
    double left = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    double far_distance = 0.0;
    std::int32_t width_px = 0;
    std::int32_t height_px = 0;
};

template <class Step, class AnyParts> bool fields(Step step, AnyParts& parts) {
    return step(parts.projection, KM_parallel_view, KM_perspective_view) && step(parts.location) &&
           step(parts.direction) && step(parts.up) && step(parts.target) &&
           step(parts.location_locked) && step(parts.direction_locked) && step(parts.up_locked) &&
           step(parts.left) && step(parts.right) && step(parts.bottom) && step(parts.top) &&
           step(parts.near_distance) && step(parts.far_distance) && step(parts.width_px) &&
           step(parts.height_px);
}

Parts partsOf(const KM_Viewport& viewport) {
    Parts parts;
    parts.projection = viewport.Projection();
    parts.location = viewport.CameraLocation();
    parts.direction = viewport.CameraDirection();
    parts.up = viewport.CameraUp();
    parts.target = viewport.TargetPoint();
    parts.location_locked = viewport.CameraLocationIsLocked();
    parts.direction_locked = viewport.CameraDirectionIsLocked();
    parts.up_locked = viewport.CameraUpIsLocked();
    viewport.GetFrustum(&parts.left, &parts.right, &parts.bottom, &parts.top, &parts.near_distance,
                        &parts.far_distance);
    viewport.GetScreenPort(&parts.width_px, &parts.height_px);
    return parts;
}

/// Projection and screen port change the frustum, so it comes after them; locks come last.
bool assemble(const Parts& parts, KM_Viewport& viewport) {
    const bool taken = viewport.SetProjection(parts.projection) &&
                       viewport.SetCameraLocation(parts.location) &&
                       viewport.SetCameraDirection(parts.direction) &&
                       viewport.SetCameraUp(parts.up) && viewport.SetTargetPoint(parts.target) &&
                       viewport.SetScreenPort(parts.width_px, parts.height_px) &&
                       viewport.SetFrustum(parts.left, parts.right, parts.bottom, parts.top,
                                           parts.near_distance, parts.far_distance);
    viewport.SetCameraLocationLock(parts.location_locked);
    viewport.SetCameraDirectionLock(parts.direction_locked);
    viewport.SetCameraUpLock(parts.up_locked);
    return taken && viewport.IsValidCamera();
}

} // namespace

bool writeViewport(KM_BinaryArchive& archive, const KM_Viewport& viewport) {
    const Parts parts = partsOf(viewport);
    return viewport.IsValidCamera() ? fields(FieldWriter(archive), parts) : archive.Fail();
}

bool readViewport(KM_BinaryArchive& archive, KM_Viewport& viewport) {
    Parts parts;
    KM_Viewport read;
    if (!fields(FieldReader(archive), parts))
        return false;
    if (!assemble(parts, read))
        return archive.Fail();
    viewport = read;
    return true;
}

} // namespace quarn
