#pragma once

#include "host/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// Where rays that met no surface meet the ground.
struct GroundLanes {
    LaneMask seen;
    Lanes weight; ///< how much of the ground shows through the haze, 0 to 1
};

/// Lets the rays that missed everything fall on the ground plane: sets their `tfar` and fills their
/// lanes of `surfaces`. The ground is seen from above only, so that it never covers a model that is
/// looked at from below, and it fades out far from the model.
inline void meetGround(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                       GroundLanes& ground) {
    RTCRay16& ray = packet.rays.ray;
    const float fade_scale = 1.0F / (frame.ground_fade_end - frame.ground_fade_start);
    for (int i = 0; i < lane_count; ++i) {
        const float height = ray.org_z[i] - frame.ground_height;
        const bool downward = ray.dir_z[i] < -1e-5F && (frame.rays.parallel || height > 0.0F);
        const float t = height / (downward ? -ray.dir_z[i] : 1.0F);
        const float x = ray.org_x[i] + t * ray.dir_x[i] - frame.ground_center[0];
        const float y = ray.org_y[i] + t * ray.dir_y[i] - frame.ground_center[1];
        const float distance = squareRoot(x * x + y * y);
        const float s = clamped((frame.ground_fade_end - distance) * fade_scale);
        const bool seen = packet.active.v[i] && !packet.hit.v[i] && downward && s > 0.0F;
        ground.seen.v[i] = seen ? -1 : 0;
        ground.weight.v[i] = seen ? s * s * (3.0F - 2.0F * s) : 0.0F;
        ray.tfar[i] = seen ? t : ray.tfar[i];
    }
    for (int i = 0; i < lane_count; ++i) {
        const bool seen = ground.seen.v[i] != 0;
        const auto put = [&](Lanes& to, float value) { to.v[i] = seen ? value : to.v[i]; };
        put(surfaces.face.x, 0.0F);
        put(surfaces.face.y, 0.0F);
        put(surfaces.face.z, 1.0F);
        put(surfaces.normal.x, 0.0F);
        put(surfaces.normal.y, 0.0F);
        put(surfaces.normal.z, 1.0F);
        put(surfaces.albedo.r, frame.ground_albedo[0]);
        put(surfaces.albedo.g, frame.ground_albedo[1]);
        put(surfaces.albedo.b, frame.ground_albedo[2]);
    }
}

} // namespace
} // namespace quarn
