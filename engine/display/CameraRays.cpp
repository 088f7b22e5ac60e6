#include "engine/display/CameraRays.h"

#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Viewport.h"

#include <algorithm>

namespace quarn {

namespace {

struct Frustum {
    double left = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    double far_distance = 0.0;
};

Frustum frustumOf(KM_Viewport viewport, int width, int height) {
    viewport.SetFrustumAspect(static_cast<double>(width) / static_cast<double>(height));
    Frustum f;
    viewport.GetFrustum(&f.left, &f.right, &f.bottom, &f.top, &f.near_distance, &f.far_distance);
    return f;
}

void storeEye(CameraRays& rays, const KM_3dPoint& eye) {
    rays.eye[0] = eye.x;
    rays.eye[1] = eye.y;
    rays.eye[2] = eye.z;
}

template <class V> void store(float (&to)[3], const V& v) {
    to[0] = static_cast<float>(v.x);
    to[1] = static_cast<float>(v.y);
    to[2] = static_cast<float>(v.z);
}

void storeFrame(CameraRays& rays, const KM_Viewport& viewport) {
    store(rays.camera_x, viewport.CameraX());
    store(rays.camera_y, viewport.CameraY());
    store(rays.camera_z, viewport.CameraZ());
}

void setPerspective(CameraRays& rays, const KM_Viewport& viewport, const Frustum& f, int width,
                    int height) {
    const KM_3dVector x = viewport.CameraX() / f.near_distance;
    const KM_3dVector y = viewport.CameraY() / f.near_distance;
    store(rays.origin, viewport.CameraLocation());
    store(rays.direction, f.left * x + f.top * y - viewport.CameraZ());
    store(rays.direction_dx, (f.right - f.left) / width * x);
    store(rays.direction_dy, (f.bottom - f.top) / height * y);
    rays.pixel_size = static_cast<float>((f.top - f.bottom) / height / f.near_distance);
    rays.pixel_width = (f.right - f.left) / width / f.near_distance;
    rays.left = f.left / f.near_distance;
    rays.top = f.top / f.near_distance;
    rays.line_near = 0.01 * f.near_distance;
    storeEye(rays, viewport.CameraLocation());
}

/// Least and greatest distance of the box's corners from the camera along the view direction.
void depthRange(const KM_Viewport& viewport, const KM_BoundingBox& box, double& nearest,
                double& farthest) {
    for (int i = 0; i < 8; ++i) {
        const double depth = (viewport.CameraLocation() - box.Corner(i)) * viewport.CameraZ();
        nearest = i == 0 ? depth : std::min(nearest, depth);
        farthest = i == 0 ? depth : std::max(farthest, depth);
    }
}

void setParallel(CameraRays& rays, const KM_Viewport& viewport, const Frustum& f, int width,
                 int height, const KM_BoundingBox& scene) {
    double nearest = 0.0;
    double farthest = 1.0;
    if (scene.IsValid())
        depthRange(viewport, scene, nearest, farthest);
    const double margin = 0.01 * (farthest - nearest) + 1e-3 * (f.top - f.bottom);
    const double setback = margin - nearest;
    const KM_3dPoint corner = viewport.CameraLocation() + f.left * viewport.CameraX() +
                              f.top * viewport.CameraY() + setback * viewport.CameraZ();
    rays.parallel = true;
    rays.setback = static_cast<float>(setback);
    rays.far_depth = static_cast<float>(farthest + setback + margin);
    store(rays.origin, corner);
    store(rays.origin_dx, (f.right - f.left) / width * viewport.CameraX());
    store(rays.origin_dy, (f.bottom - f.top) / height * viewport.CameraY());
    store(rays.direction, -viewport.CameraZ());
    rays.pixel_size = static_cast<float>((f.top - f.bottom) / height);
    rays.pixel_width = (f.right - f.left) / width;
    rays.left = f.left;
    rays.top = f.top;
    storeEye(rays, viewport.CameraLocation() + setback * viewport.CameraZ());
}

} // namespace

CameraRays cameraRays(const KM_Viewport& viewport, int width, int height,
                      const KM_BoundingBox& scene) {
    const Frustum frustum = frustumOf(viewport, width, height);
    CameraRays rays;
    storeFrame(rays, viewport);
    if (viewport.IsPerspectiveProjection())
        setPerspective(rays, viewport, frustum, width, height);
    else
        setParallel(rays, viewport, frustum, width, height, scene);
    return rays;
}

double depthOf(const CameraRays& rays, const KM_3dPoint& p) {
    return (rays.eye[0] - p.x) * rays.camera_z[0] + (rays.eye[1] - p.y) * rays.camera_z[1] +
           (rays.eye[2] - p.z) * rays.camera_z[2];
}

} // namespace quarn
