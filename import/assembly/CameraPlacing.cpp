#include "import/assembly/CameraPlacing.h"

#include "import/assembly/MeshPlacing.h"

namespace quarn {

namespace {

constexpr double NEAR_DISTANCE = 0.1;
constexpr double FAR_DISTANCE = 1000.0;

double targetDistance(const KM_BoundingBox& bounds, const KM_3dPoint& location,
                      const KM_3dVector& direction) {
    const double distance = bounds.IsValid() ? (bounds.Center() - location) * direction : 1.0;
    return distance > 1e-6 ? distance : 1.0;
}

void setOpening(const SourceCamera& camera, KM_Viewport& viewport) {
    if (camera.is_parallel)
        viewport.SetProjection(KM_parallel_view);
    if (!camera.half_width)
        return;
    const double half_width = *camera.half_width * (camera.is_parallel ? 1.0 : NEAR_DISTANCE);
    viewport.SetFrustum(-half_width, half_width, -half_width / camera.aspect,
                        half_width / camera.aspect, NEAR_DISTANCE, FAR_DISTANCE);
}

} // namespace

std::optional<ImportedCamera> placeCamera(const SourceCamera& camera,
                                          const KM_BoundingBox& bounds) {
    const KM_3dPoint& location = camera.location;
    KM_3dVector direction = camera.direction;
    ImportedCamera placed;
    placed.name = camera.name;
    KM_Viewport& viewport = placed.viewport;
    if (!isUsableCoordinate(location.x) || !isUsableCoordinate(location.y) ||
        !isUsableCoordinate(location.z) || !direction.Unitize() ||
        !viewport.SetCameraLocation(location))
        return std::nullopt;
    const KM_3dPoint target = location + direction * targetDistance(bounds, location, direction);
    viewport.SetTargetPoint(target);
    viewport.SetCameraDirection(target - location);
    viewport.SetCameraUp(camera.up);
    setOpening(camera, viewport);
    if (!viewport.IsValidCamera())
        return std::nullopt;
    return placed;
}

} // namespace quarn
