#include "host/session/ViewNavigation.h"

#include "host/document/CameraMove.h"
#include "host/document/Document.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

/// How high above and below the target the camera goes: so near the vertical the horizon can still
/// be told.
constexpr double STEEPEST_RAD = 89.9 / 180.0 * std::numbers::pi;

/// The sine of the angle to an axis below which a parallel view counts as a plan of the model.
constexpr double PLAN_SINE = 1e-6;

/// The nearest that a camera comes to its target, and the least height of a parallel picture, as a
/// share of the largest coordinate: what is nearer has too few digits for the camera to turn.
constexpr double LEAST_SHARE = 1e-7;
constexpr double LEAST_DISTANCE = 1e-9;
constexpr double GREATEST_DISTANCE = 1e12;

struct Frustum {
    double left = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    double far_distance = 0.0;
};

Frustum frustumOf(const KM_Viewport& camera) {
    Frustum f;
    camera.GetFrustum(&f.left, &f.right, &f.bottom, &f.top, &f.near_distance, &f.far_distance);
    return f;
}

/// What the camera moves about: its target, where that lies before the camera; else what it looks
/// at, as far away as its direction is long.
struct Pivot {
    KM_3dPoint point;
    double depth = 0.0; ///< along the view direction
};

Pivot pivotOf(const KM_Viewport& camera) {
    const double depth = camera.TargetDistance();
    if (KM_IsValid(depth) && depth > 0.0)
        return {camera.TargetPoint(), depth};
    const double length = camera.CameraDirection().Length();
    return {camera.CameraLocation() - length * camera.CameraZ(), length};
}

/// The pivot of a turn. One beside the middle of the picture would make the picture jump into the
/// middle when the turn begins, so the point of its depth in the middle takes its place.
KM_3dPoint middleOfTurn(const KM_Viewport& camera, const Pivot& pivot) {
    const KM_3dPoint middle = camera.CameraLocation() - pivot.depth * camera.CameraZ();
    return middle.DistanceTo(pivot.point) <= 1e-6 * pivot.depth ? pivot.point : middle;
}

bool isPlan(const KM_Viewport& camera) {
    const KM_3dVector& z = camera.CameraZ();
    const double along = std::max({std::abs(z.x), std::abs(z.y), std::abs(z.z)});
    return camera.IsParallelProjection() &&
           std::sqrt(std::max(0.0, 1.0 - along * along)) < PLAN_SINE;
}

/// Where the camera stands as seen from its target: angles as on a globe.
struct GlobePlace {
    double longitude = 0.0;
    double latitude = 0.0;
};

/// Straight above or below the target, the right of the picture tells the longitude.
GlobePlace placeOf(const KM_Viewport& camera) {
    const KM_3dVector& z = camera.CameraZ();
    const KM_3dVector& x = camera.CameraX();
    const double across = std::hypot(z.x, z.y);
    return {across > PLAN_SINE ? std::atan2(z.y, z.x) : std::atan2(-x.x, x.y),
            std::atan2(z.z, across)};
}

KM_3dVector directionTo(const GlobePlace& place) {
    const double across = std::cos(place.latitude);
    return {across * std::cos(place.longitude), across * std::sin(place.longitude),
            std::sin(place.latitude)};
}

/// Moves the camera with what it looks at.
bool shift(KM_Viewport& camera, const KM_3dVector& by) {
    const KM_3dPoint location = camera.CameraLocation() + by;
    const KM_3dPoint target = pivotOf(camera).point + by;
    return camera.SetCameraLocation(location) && camera.SetTargetPoint(target);
}

/// Model units of a pixel at the pivot's depth, across and down.
struct PixelSize {
    double width = 0.0;
    double height = 0.0;
};

PixelSize pixelAtPivot(const KM_Viewport& camera) {
    const Frustum f = frustumOf(camera);
    int width_px = 1;
    int height_px = 1;
    camera.GetScreenPort(&width_px, &height_px);
    const double growth =
        camera.IsPerspectiveProjection() ? pivotOf(camera).depth / f.near_distance : 1.0;
    return {growth * (f.right - f.left) / width_px, growth * (f.top - f.bottom) / height_px};
}

/// The factor, moved back so that `size` over it stays in the range that keeps its digits.
double limited(double factor, double size, const KM_3dPoint& near_point) {
    const double coordinate =
        std::max({std::abs(near_point.x), std::abs(near_point.y), std::abs(near_point.z)});
    const double least = std::max(LEAST_DISTANCE, LEAST_SHARE * coordinate);
    if (factor > 1.0)
        return std::max(1.0, std::min(factor, size / least));
    return std::min(1.0, std::max(factor, size / GREATEST_DISTANCE));
}

/// The point at the pivot's depth that is seen at a place of the picture, from the pivot's foot on
/// the view axis.
KM_3dVector offsetAt(const KM_Viewport& camera, double x_px, double y_px) {
    const Frustum f = frustumOf(camera);
    const PixelSize pixel = pixelAtPivot(camera);
    const double growth =
        camera.IsPerspectiveProjection() ? pivotOf(camera).depth / f.near_distance : 1.0;
    return (growth * f.left + x_px * pixel.width) * camera.CameraX() +
           (growth * f.top - y_px * pixel.height) * camera.CameraY();
}

/// Everything shrinks about the point under the mouse, which so keeps its place.
bool zoomPerspective(KM_Viewport& camera, double wanted, double x_px, double y_px) {
    const Pivot pivot = pivotOf(camera);
    const double factor = limited(wanted, pivot.depth, pivot.point);
    const KM_3dVector to_mouse =
        offsetAt(camera, x_px, y_px) - pivot.depth * camera.CameraZ(); // from the camera
    const double way = 1.0 - 1.0 / factor;
    const KM_3dPoint mouse = camera.CameraLocation() + to_mouse;
    const double depth = pivot.depth / factor;
    return camera.SetCameraLocation(camera.CameraLocation() + way * to_mouse) &&
           camera.SetTargetPoint(pivot.point + way * (mouse - pivot.point)) &&
           camera.SetFrustumNearFar(depth / 1000.0,
                                    std::max(frustumOf(camera).far_distance, 100.0 * depth));
}

bool zoomParallel(KM_Viewport& camera, double wanted, double x_px, double y_px) {
    const Frustum f = frustumOf(camera);
    const double factor = limited(wanted, f.top - f.bottom, pivotOf(camera).point);
    const double way = 1.0 - 1.0 / factor;
    return shift(camera, way * offsetAt(camera, x_px, y_px)) &&
           camera.SetFrustum(f.left / factor, f.right / factor, f.bottom / factor, f.top / factor,
                             f.near_distance, f.far_distance);
}

} // namespace

void orbitView(CQuarnView& view, double right_px, double down_px) {
    ViewState& state = ViewState::of(view);
    if (!state.isOpen() || !std::isfinite(right_px) || !std::isfinite(down_px))
        return;
    KM_Viewport camera = state.frameCamera();
    if (isPlan(camera))
        return panView(view, right_px, down_px);
    GlobePlace place = placeOf(camera);
    place.longitude -= std::numbers::pi * right_px / state.frameWidth();
    place.latitude = std::clamp(place.latitude + std::numbers::pi * down_px / state.frameHeight(),
                                -STEEPEST_RAD, STEEPEST_RAD);
    const Pivot pivot = pivotOf(camera);
    const KM_3dPoint middle = middleOfTurn(camera, pivot);
    const double distance = camera.CameraLocation().DistanceTo(middle);
    if (moveCamera(camera, middle, middle + distance * directionTo(place), true) &&
        camera.SetTargetPoint(middle))
        state.setViewport(camera, true, true);
}

void panView(CQuarnView& view, double right_px, double down_px) {
    ViewState& state = ViewState::of(view);
    if (!state.isOpen())
        return;
    KM_Viewport camera = state.frameCamera();
    const PixelSize pixel = pixelAtPivot(camera);
    const KM_3dVector by =
        -right_px * pixel.width * camera.CameraX() + down_px * pixel.height * camera.CameraY();
    if (by.IsValid() && shift(camera, by))
        state.setViewport(camera, true, true);
}

void zoomView(CQuarnView& view, double factor, double x_px, double y_px) {
    ViewState& state = ViewState::of(view);
    const bool is_finite = std::isfinite(factor) && std::isfinite(x_px) && std::isfinite(y_px);
    if (!state.isOpen() || !is_finite || factor <= 0.0)
        return;
    KM_Viewport camera = state.frameCamera();
    const auto zoom = camera.IsPerspectiveProjection() ? zoomPerspective : zoomParallel;
    if (zoom(camera, factor, x_px, y_px))
        state.setViewport(camera, true, true);
}

} // namespace quarn
