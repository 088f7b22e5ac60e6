#pragma once

#include "engine/display/kernel/Lanes.h"

namespace quarn {
namespace {

/// Sixteen rays through places of the picture and what they met.
struct RayPacket {
    Lanes x; ///< continuous pixels
    Lanes y;
    LaneMask active;
    LaneMask hit;
    Lanes distance; ///< to what the ray met, in lengths of the direction
    RTCRayHit16 rays;

    LaneVectors origin() const {
        return {load(rays.ray.org_x), load(rays.ray.org_y), load(rays.ray.org_z)};
    }
    LaneVectors direction() const {
        return {load(rays.ray.dir_x), load(rays.ray.dir_y), load(rays.ray.dir_z)};
    }
};

/// A ray that must not travel still needs finite numbers.
constexpr float no_distance = -1.0F;
constexpr float unlimited = 1e30F;

inline void prepare(RTCRay16& ray) {
    store(ray.tnear, 0.0F);
    store(ray.time, 0.0F);
    store(ray.mask, -1);
    store(ray.id, 0);
    store(ray.flags, 0);
}

inline void setOrigin(RTCRay16& ray, const LaneVectors& origin) {
    store(ray.org_x, origin.x);
    store(ray.org_y, origin.y);
    store(ray.org_z, origin.z);
}

inline void setDirection(RTCRay16& ray, const LaneVectors& direction) {
    store(ray.dir_x, direction.x);
    store(ray.dir_y, direction.y);
    store(ray.dir_z, direction.z);
}

/// start + x * dx + y * dy
inline LaneVectors atPixels(const RayPacket& packet, const float (&start)[3], const float (&dx)[3],
                            const float (&dy)[3]) {
    return {packet.x * dx[0] + packet.y * dy[0] + start[0],
            packet.x * dx[1] + packet.y * dy[1] + start[1],
            packet.x * dx[2] + packet.y * dy[2] + start[2]};
}

inline void aim(const FrameSetup& frame, RayPacket& packet) {
    const CameraRays& c = frame.rays;
    setOrigin(packet.rays.ray, atPixels(packet, c.origin, c.origin_dx, c.origin_dy));
    setDirection(packet.rays.ray, atPixels(packet, c.direction, c.direction_dx, c.direction_dy));
}

/// Finds the nearest surface of each ray.
/// @param flags  whether the rays run nearly side by side
inline void intersect(const FrameSetup& frame, RayPacket& packet,
                      RTCIntersectContextFlags flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT) {
    RTCRayHit16& rays = packet.rays;
    constexpr auto nothing = static_cast<std::int32_t>(RTC_INVALID_GEOMETRY_ID);
    store(rays.ray.tfar, select(packet.active, unlimited, no_distance));
    store(rays.hit.geomID, nothing);
    store(rays.hit.instID[0], nothing);
    if (frame.scene) {
        RTCIntersectContext context;
        rtcInitIntersectContext(&context);
        context.flags = flags;
        rtcIntersect16(packet.active.data(), frame.scene, &context, &rays);
    }
    packet.hit = load(rays.hit.geomID) != nothing;
    packet.distance = load(rays.ray.tfar);
}

/// How near the hits are, in the measure of DepthImage.
inline Lanes nearnessOf(const FrameSetup& frame, const RayPacket& packet) {
    const Lanes nearness = frame.rays.parallel ? Lanes(frame.rays.far_depth) - packet.distance
                                               : Lanes(1.0F) / packet.distance;
    return select(packet.hit, nearness, 0.0F);
}

} // namespace
} // namespace quarn
