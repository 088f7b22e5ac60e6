#include "engine/display/RayPick.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/FlushDenormals.h"
#include "engine/display/FrontsAlone.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace quarn {

namespace {

/// A part of a ray, by distances from its origin.
struct Reach {
    double from = 0.0;
    double to = std::numeric_limits<double>::infinity();
};

/// What a slab between two parallel planes leaves of it.
void clip(Reach& reach, double origin, double direction, double low, double high) {
    if (direction == 0.0) {
        if (origin < low || origin > high)
            reach.to = -std::numeric_limits<double>::infinity();
        return;
    }
    const double a = (low - origin) / direction;
    const double b = (high - origin) / direction;
    reach.from = std::max(reach.from, std::min(a, b));
    reach.to = std::min(reach.to, std::max(a, b));
}

/// The part of the ray that lies in the box of all surfaces. Rays begin there: in the single
/// precision of the ray tracer, what is far away would be met beside its place.
Reach reachIn(const KM_BoundingBox& box, const PickRay& ray) {
    const KM_3dVector size = box.Diagonal();
    const double margin = 1e-3 * size.Length() + 1e-6;
    Reach reach;
    if (ray.is_parallel)
        reach.from = -std::numeric_limits<double>::infinity();
    clip(reach, ray.origin.x, ray.direction.x, box.m_min.x - margin, box.m_max.x + margin);
    clip(reach, ray.origin.y, ray.direction.y, box.m_min.y - margin, box.m_max.y + margin);
    clip(reach, ray.origin.z, ray.direction.z, box.m_min.z - margin, box.m_max.z + margin);
    return reach;
}

RTCRayHit rayHit(const KM_3dVector& origin, const KM_3dVector& direction, double length) {
    RTCRayHit ray{};
    ray.ray.org_x = static_cast<float>(origin.x);
    ray.ray.org_y = static_cast<float>(origin.y);
    ray.ray.org_z = static_cast<float>(origin.z);
    ray.ray.dir_x = static_cast<float>(direction.x);
    ray.ray.dir_y = static_cast<float>(direction.y);
    ray.ray.dir_z = static_cast<float>(direction.z);
    ray.ray.tfar = static_cast<float>(length);
    ray.ray.mask = ~0U;
    ray.hit.geomID = RTC_INVALID_GEOMETRY_ID;
    ray.hit.instID[0] = RTC_INVALID_GEOMETRY_ID;
    return ray;
}

void shoot(const RayScene& rays, bool passes_backs, RTCRayHit& ray) {
    FrontsAlone fronts{{},
                       rays.surfaces().data(),
                       rays.hasInstances() ? rays.firstSurfaces().data() : nullptr,
                       static_cast<std::uint32_t>(rays.soleFirstSurface())};
    passBacks(fronts);
    if (!passes_backs || !rays.hasOneSided())
        fronts.context.filter = nullptr;
    const FlushDenormals flushing;
    rtcIntersect1(rays.root(), &fronts.context, &ray);
}

/// How far along the ray the plane of a triangle is; what the ray tracer found where that is no
/// plane, or seen edge-on.
double planeDistance(const DisplayScene& scene, const SurfaceHit& hit, unsigned triangle,
                     const PickRay& ray) {
    const DisplayScene::MeshObject& object = scene.meshes()[hit.mesh];
    const KM_Mesh& mesh = object.mesh->mesh();
    const auto vertex = [&](int corner) {
        const std::uint32_t index = mesh.m_F[triangle].vi[corner];
        return object.frame_from_mesh * mesh.m_V[index].ToDouble();
    };
    const KM_3dPoint corner = vertex(0);
    const KM_3dVector normal = KM_CrossProduct(vertex(1) - corner, vertex(2) - corner);
    const KM_3dVector from_origin = (corner - ray.origin) + (scene.origin() - KM_3dPoint::Origin);
    const double slope = normal * ray.direction;
    const double distance = (normal * from_origin) / slope;
    const bool is_plain = std::abs(slope) > 1e-4 * normal.Length() && std::isfinite(distance);
    return is_plain ? distance : hit.distance;
}

} // namespace

std::optional<SurfaceHit> firstSurface(const DisplayScene& scene, const PickRay& ray) {
    const RayScene& rays = scene.rays();
    if (!rays.root() || !scene.surfaceBox().IsValid())
        return std::nullopt;
    const Reach reach = reachIn(scene.surfaceBox(), ray);
    if (!(reach.from < reach.to) || !std::isfinite(reach.to - reach.from))
        return std::nullopt;
    const KM_3dVector start = (ray.origin + reach.from * ray.direction) - scene.origin();
    RTCRayHit found = rayHit(start, ray.direction, reach.to - reach.from);
    shoot(rays, ray.passes_backs, found);
    if (found.hit.geomID == RTC_INVALID_GEOMETRY_ID)
        return std::nullopt;
    const std::size_t first =
        rays.hasInstances() ? rays.firstSurfaces()[found.hit.instID[0]] : rays.soleFirstSurface();
    SurfaceHit hit;
    hit.mesh = scene.meshOfSurface(first + found.hit.geomID);
    hit.distance = reach.from + static_cast<double>(found.ray.tfar);
    hit.distance = planeDistance(scene, hit, found.hit.primID, ray);
    hit.point = ray.origin + hit.distance * ray.direction;
    return hit;
}

} // namespace quarn
