#pragma once

#include "host/display/kernel/Lanes.h"

namespace quarn {
namespace {

/// Sixteen rays through places of the picture and what they met.
struct RayPacket {
    Lanes x; ///< continuous pixels
    Lanes y;
    LaneMask active;
    LaneMask hit;
    RTCRayHit16 rays;
};

/// A ray that must not travel still needs finite numbers.
constexpr float no_distance = -1.0F;
constexpr float unlimited = 1e30F;

/// Sets what no ray changes on its way.
inline void prepare(RayPacket& packet) {
    for (int i = 0; i < lane_count; ++i) {
        packet.rays.ray.time[i] = 0.0F;
        packet.rays.ray.mask[i] = 0xFFFFFFFFU;
        packet.rays.ray.flags[i] = 0;
        packet.rays.ray.id[i] = 0;
        packet.rays.ray.tnear[i] = 0.0F;
    }
}

inline void aim(const FrameSetup& frame, RayPacket& packet) {
    const CameraRays& c = frame.rays;
    RTCRay16& ray = packet.rays.ray;
    for (int i = 0; i < lane_count; ++i) {
        const float x = packet.x.v[i];
        const float y = packet.y.v[i];
        ray.dir_x[i] = c.direction[0] + x * c.direction_dx[0] + y * c.direction_dy[0];
        ray.dir_y[i] = c.direction[1] + x * c.direction_dx[1] + y * c.direction_dy[1];
        ray.dir_z[i] = c.direction[2] + x * c.direction_dx[2] + y * c.direction_dy[2];
        ray.tfar[i] = packet.active.v[i] ? unlimited : no_distance;
        packet.rays.hit.geomID[i] = RTC_INVALID_GEOMETRY_ID;
        packet.rays.hit.instID[0][i] = RTC_INVALID_GEOMETRY_ID;
    }
    for (int i = 0; i < lane_count; ++i) {
        const float x = packet.x.v[i];
        const float y = packet.y.v[i];
        ray.org_x[i] = c.origin[0] + x * c.origin_dx[0] + y * c.origin_dy[0];
        ray.org_y[i] = c.origin[1] + x * c.origin_dx[1] + y * c.origin_dy[1];
        ray.org_z[i] = c.origin[2] + x * c.origin_dx[2] + y * c.origin_dy[2];
    }
}

inline RTCIntersectContext coherentContext() {
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    context.flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT;
    return context;
}

/// Finds the nearest surface of each ray.
inline void intersect(const FrameSetup& frame, RayPacket& packet) {
    if (frame.scene) {
        RTCIntersectContext context = coherentContext();
        rtcIntersect16(packet.active.v, frame.scene, &context, &packet.rays);
    }
    for (int i = 0; i < lane_count; ++i)
        packet.hit.v[i] = packet.rays.hit.geomID[i] != RTC_INVALID_GEOMETRY_ID ? -1 : 0;
}

/// How near the hits are, in the measure of DepthImage.
inline void nearnessOf(const FrameSetup& frame, const RayPacket& packet, Lanes& nearness) {
    for (int i = 0; i < lane_count; ++i) {
        const float t = packet.rays.ray.tfar[i];
        const float near = frame.rays.parallel ? frame.rays.far_depth - t : 1.0F / t;
        nearness.v[i] = packet.hit.v[i] ? near : 0.0F;
    }
}

} // namespace
} // namespace quarn
