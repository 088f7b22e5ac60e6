#pragma once

#include "engine/display/OpacityFilter.h"
#include "engine/display/kernel/ShadowTerminator.h"
#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// How far a shadow ray starts from the surface, so that rounding never lets it hit the very
/// triangle it leaves.
inline Lanes shadowOffset(const FrameSetup& frame, const Lanes& distance,
                          const LaneVectors& place) {
    const Lanes reach = greatest(greatest(absolute(place.x), absolute(place.y)),
                                 greatest(absolute(place.z), absolute(distance)));
    return Lanes(1e-5F * frame.scene_size) + reach * 2e-6F;
}

/// True where a ray from the point toward the sun can meet the box of the scene at all.
inline LaneMask reachesScene(const FrameSetup& frame, const FrameLight& sun,
                             const LaneVectors& from) {
    const Lanes* const place[3] = {&from.x, &from.y, &from.z};
    Lanes enter = 0.0F;
    Lanes leave = unlimited;
    for (int axis = 0; axis < 3; ++axis) {
        const float d = sun.toward[axis];
        const float scale = 1.0F / (d > 1e-12F || d < -1e-12F ? d : 1e-12F);
        const Lanes a = (Lanes(frame.scene_min[axis]) - *place[axis]) * scale;
        const Lanes b = (Lanes(frame.scene_max[axis]) - *place[axis]) * scale;
        enter = greatest(enter, least(a, b));
        leave = least(leave, greatest(a, b));
    }
    return ~(enter > leave);
}

/// A facet of a smooth surface that turns away from the sun must not shadow itself.
inline void liftTurnedAway(const FrameSetup& frame, const RayPacket& packet,
                           const SurfaceLanes& surfaces, unsigned turned_away, RTCRay16& ray) {
    alignas(64) std::uint32_t surface[lane_count];
    store(surface, surfaces.surface);
    alignas(64) float faces[3][lane_count];
    store(faces[0], surfaces.face.x);
    store(faces[1], surfaces.face.y);
    store(faces[2], surfaces.face.z);
    for (; turned_away != 0; turned_away &= turned_away - 1) {
        const int i = __builtin_ctz(turned_away);
        const float face[3] = {faces[0][i], faces[1][i], faces[2][i]};
        liftToSmoothSurface(frame.surfaces[surface[i]], packet.rays.hit, i, face, ray);
    }
}

/// The part of a light that arrives where see-through surfaces may stand before it.
[[gnu::noinline]] inline Lanes throughPanes(const FrameSetup& frame, float shadow,
                                            const LaneMask& look, RTCRay16& ray) {
    PassingLight light;
    rtcInitIntersectContext(&light.context);
    for (int i = 0; i < lane_count; ++i) {
        light.passed[i] = 1.0F;
        ray.id[i] = static_cast<unsigned>(i + 1);
    }
    rtcOccluded16(look.data(), frame.scene, &light.context, &ray);
    alignas(64) float passed[lane_count];
    for (int i = 0; i < lane_count; ++i)
        passed[i] = light.passed[i];
    const Lanes kept_off = select(load(ray.tfar) < 0.0F, Lanes(1.0F), Lanes(1.0F) - load(passed));
    return select(look, Lanes(1.0F) - kept_off * shadow, 1.0F);
}

/// Where shadow rays start.
struct ShadowStart {
    LaneMask look; ///< the lanes that look toward the light
    Lanes distance;
    LaneVectors place;
};

/// @param lanes  those whose places are asked for; to begin with all of them look
inline ShadowStart shadowStart(const RayPacket& packet, const LaneMask& lanes) {
    const Lanes t = select(lanes, packet.distance, 0.0F);
    return {lanes, t, along(packet.origin(), packet.direction(), t)};
}

/// Looks toward a light.
/// @param shadow  how much of it is kept off where something stands before it
/// @param toward  unit vectors
/// @param reach   how far away the light is
/// @return the part of it that arrives
inline Lanes lightArriving(const FrameSetup& frame, float shadow, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const ShadowStart& start,
                           const LaneVectors& toward, const Lanes& reach) {
    const LaneMask& look = start.look;
    RTCRay16 ray;
    prepare(ray);
    setOrigin(ray,
              along(start.place, surfaces.face, shadowOffset(frame, start.distance, start.place)));
    setDirection(ray, toward);
    store(ray.tfar, select(look, reach, no_distance));
    const LaneMask turned_away = packet.hit & look & (dot(surfaces.face, toward) < Lanes(0.25F));
    if (any(turned_away))
        liftTurnedAway(frame, packet, surfaces, bits(turned_away), ray);
    // Not coherent: occlusion packets of partly masked rays do not end there in Embree 3.13.
    if (frame.has_see_through)
        return throughPanes(frame, shadow, look, ray);
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(look.data(), frame.scene, &context, &ray);
    return select(look & (load(ray.tfar) < 0.0F), 1.0F - shadow, 1.0F);
}

/// Looks from the lanes of `wanted` toward the sun.
/// @return the part of the sun's light that arrives; 1 in the other lanes
inline Lanes sunlightArriving(const FrameSetup& frame, const FrameLight& sun,
                              const RayPacket& packet, const SurfaceLanes& surfaces,
                              const LaneMask& wanted) {
    if (!frame.scene || sun.shadow <= 0.0F || !any(wanted))
        return 1.0F;
    ShadowStart start = shadowStart(packet, wanted);
    start.look = start.look & reachesScene(frame, sun, start.place);
    if (!any(start.look))
        return 1.0F;
    return lightArriving(frame, sun.shadow, packet, surfaces, start,
                         {sun.toward[0], sun.toward[1], sun.toward[2]}, unlimited);
}

} // namespace
} // namespace quarn
