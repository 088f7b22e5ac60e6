#include "host/document/StandardViews.h"

namespace quarn {

namespace {

constexpr StandardView STANDARD_VIEWS[] = {
    {L"Top", 43101, KM_parallel_view, {0.0, 0.0, 1.0}},
    {L"Front", 43102, KM_parallel_view, {0.0, -1.0, 0.0}},
    {L"Right", 43103, KM_parallel_view, {1.0, 0.0, 0.0}},
    {L"Perspective", 43104, KM_perspective_view, {40.0, -60.0, 35.0}},
};

constexpr double LENS_LENGTH_MM = 50.0;

} // namespace

std::span<const StandardView> standardViews() {
    return STANDARD_VIEWS;
}

KM_Viewport standardViewport(const StandardView& view, const KM_3dPoint& target, double distance,
                             int width_px, int height_px) {
    KM_3dVector to_camera = view.direction_to_camera;
    to_camera.Unitize();
    const bool from_above = to_camera.x == 0.0 && to_camera.y == 0.0;

    KM_Viewport viewport;
    viewport.SetCameraLocation(target + distance * to_camera);
    viewport.SetCameraDirection(-distance * to_camera);
    viewport.SetCameraUp(from_above ? KM_3dVector::YAxis : KM_3dVector::ZAxis);
    viewport.SetTargetPoint(target);
    viewport.SetFrustumNearFar(distance / 1000.0, distance * 100.0);
    viewport.SetScreenPort(width_px, height_px);
    viewport.SetCamera35mmLensLength(LENS_LENGTH_MM);
    viewport.SetProjection(view.projection);
    return viewport;
}

KM_Viewport turnedTo(const StandardView& view, const KM_Viewport& viewport) {
    const bool has_target = viewport.TargetDistance() > 0.0;
    const KM_3dPoint target = has_target ? viewport.TargetPoint() : KM_3dPoint::Origin;
    const double distance =
        has_target ? viewport.TargetDistance() : viewport.CameraDirection().Length();
    int width_px = 0;
    int height_px = 0;
    viewport.GetScreenPort(&width_px, &height_px);
    return standardViewport(view, target, distance, width_px, height_px);
}

} // namespace quarn
