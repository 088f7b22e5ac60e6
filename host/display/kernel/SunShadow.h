#pragma once

#include "host/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// How far a shadow ray starts from the surface, so that rounding never lets it hit the very
/// triangle it leaves.
inline float shadowOffset(const FrameSetup& frame, float distance, float x, float y, float z) {
    const float reach =
        greatest(greatest(absolute(x), absolute(y)), greatest(absolute(z), distance));
    return 1e-5F * frame.scene_size + 2e-6F * reach;
}

/// A facet of a smooth surface that faces away from the sun shadows itself although the smooth
/// normal still faces the sun, which draws the facets along the border of light. There the shadow
/// ray starts from the smooth surface above the facet (J. Hanika, "Hacking the Shadow Terminator",
/// Ray Tracing Gems II, chapter 4).
inline void liftToSmoothSurface(const RaySurface& surface, const RTCHit16& hit, int i,
                                RTCRay16& ray) {
    const std::uint32_t triangle = hit.primID[i];
    const std::uint32_t* const vertex = surface.triangles[triangle].vi;
    const float weight[3] = {1.0F - hit.u[i] - hit.v[i], hit.u[i], hit.v[i]};
    const KM_3fPoint& a = surface.vertices[vertex[0]];
    const KM_3fPoint& b = surface.vertices[vertex[1]];
    const KM_3fPoint& c = surface.vertices[vertex[2]];
    const Vector place{weight[0] * a.x + weight[1] * b.x + weight[2] * c.x,
                       weight[0] * a.y + weight[1] * b.y + weight[2] * c.y,
                       weight[0] * a.z + weight[1] * b.z + weight[2] * c.z};
    for (int corner = 0; corner < 3; ++corner) {
        const KM_3fPoint& at = surface.vertices[vertex[corner]];
        Vector n = unpacked(
            surface.corner_normals[std::size_t{3} * triangle + static_cast<std::size_t>(corner)]);
        const float scale = 1.0F / squareRoot(n.x * n.x + n.y * n.y + n.z * n.z);
        n = {n.x * scale, n.y * scale, n.z * scale};
        const float below =
            least(0.0F, (place.x - at.x) * n.x + (place.y - at.y) * n.y + (place.z - at.z) * n.z);
        ray.org_x[i] -= weight[corner] * below * n.x;
        ray.org_y[i] -= weight[corner] * below * n.y;
        ray.org_z[i] -= weight[corner] * below * n.z;
    }
}

/// True when a ray from the point toward the sun can meet the box of the scene at all.
inline bool reachesScene(const FrameSetup& frame, const FrameLight& sun, float x, float y,
                         float z) {
    const float p[3] = {x, y, z};
    float enter = 0.0F;
    float leave = unlimited;
    for (int axis = 0; axis < 3; ++axis) {
        const float d = absolute(sun.toward[axis]) > 1e-12F ? sun.toward[axis] : 1e-12F;
        const float t0 = (frame.scene_min[axis] - p[axis]) / d;
        const float t1 = (frame.scene_max[axis] - p[axis]) / d;
        enter = greatest(enter, least(t0, t1));
        leave = least(leave, greatest(t0, t1));
    }
    return enter <= leave;
}

/// Looks from the lit lanes toward the sun.
/// @param facing  cosine between shading normal and sun; lanes at or below 0 are not looked at
/// @param light   receives the part of the sun's light that arrives
inline void sunShadow(const FrameSetup& frame, const FrameLight& sun, const RayPacket& packet,
                      const SurfaceLanes& surfaces, const LaneMask& lit, const Lanes& facing,
                      Lanes& light) {
    for (int i = 0; i < lane_count; ++i)
        light.v[i] = 1.0F;
    if (!frame.scene || sun.shadow <= 0.0F)
        return;
    const RTCRay16& eye = packet.rays.ray;
    RTCRay16 ray;
    LaneMask look;
    LaneMask turned_away;
    for (int i = 0; i < lane_count; ++i) {
        const bool wanted = lit.v[i] && facing.v[i] > 0.0F;
        const float t = wanted ? eye.tfar[i] : 0.0F;
        const float x = eye.org_x[i] + t * eye.dir_x[i];
        const float y = eye.org_y[i] + t * eye.dir_y[i];
        const float z = eye.org_z[i] + t * eye.dir_z[i];
        const float offset = shadowOffset(frame, t, x, y, z);
        ray.org_x[i] = x + offset * surfaces.face.x.v[i];
        ray.org_y[i] = y + offset * surfaces.face.y.v[i];
        ray.org_z[i] = z + offset * surfaces.face.z.v[i];
        ray.dir_x[i] = sun.toward[0];
        ray.dir_y[i] = sun.toward[1];
        ray.dir_z[i] = sun.toward[2];
        ray.tnear[i] = 0.0F;
        ray.time[i] = 0.0F;
        ray.mask[i] = 0xFFFFFFFFU;
        ray.id[i] = 0;
        ray.flags[i] = 0;
        const float face_turn = surfaces.face.x.v[i] * sun.toward[0] +
                                surfaces.face.y.v[i] * sun.toward[1] +
                                surfaces.face.z.v[i] * sun.toward[2];
        turned_away.v[i] = packet.hit.v[i] && wanted && face_turn < 0.25F ? -1 : 0;
        look.v[i] = wanted && reachesScene(frame, sun, x, y, z) ? -1 : 0;
        ray.tfar[i] = look.v[i] ? unlimited : no_distance;
    }
    if (!any(look))
        return;
    if (any(turned_away)) {
        for (int i = 0; i < lane_count; ++i)
            if (turned_away.v[i] && frame.surfaces[surfaces.surface[i]].corner_normals)
                liftToSmoothSurface(frame.surfaces[surfaces.surface[i]], packet.rays.hit, i, ray);
    }
    // Not coherent: occlusion packets of partly masked rays do not end there in Embree 3.13.
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(look.v, frame.scene, &context, &ray);
    for (int i = 0; i < lane_count; ++i)
        light.v[i] = look.v[i] && ray.tfar[i] < 0.0F ? 1.0F - sun.shadow : 1.0F;
}

} // namespace
} // namespace quarn
