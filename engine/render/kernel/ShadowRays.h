#pragma once

#include "engine/display/kernel/SunShadow.h"
#include "engine/render/TintedLight.h"
#include "engine/render/kernel/Directions.h"

namespace quarn {
namespace {

/// True where a ray can meet the box of the scene at all.
inline LaneMask reachesBox(const FrameSetup& frame, const LaneVectors& from,
                           const LaneVectors& direction) {
    const Lanes* const place[3] = {&from.x, &from.y, &from.z};
    const Lanes* const way[3] = {&direction.x, &direction.y, &direction.z};
    Lanes enter = 0.0F;
    Lanes leave = unlimited;
    for (int axis = 0; axis < 3; ++axis) {
        const Lanes& d = *way[axis];
        const Lanes scale = Lanes(1.0F) / select(absolute(d) > Lanes(1e-12F), d, 1e-12F);
        const Lanes a = (Lanes(frame.scene_min[axis]) - *place[axis]) * scale;
        const Lanes b = (Lanes(frame.scene_max[axis]) - *place[axis]) * scale;
        enter = greatest(enter, least(a, b));
        leave = least(leave, greatest(a, b));
    }
    return ~(enter > leave);
}

/// Places of surfaces that rays start from.
struct StartLanes {
    LaneVectors place;
    LaneVectors off; ///< a little above the surface
};

inline StartLanes startLanes(const FrameSetup& frame, const RayPacket& packet,
                             const SurfaceLanes& surfaces, const LaneMask& lit) {
    const Lanes t = select(lit, packet.distance, 0.0F);
    const LaneVectors place = along(packet.origin(), packet.direction(), t);
    return {place, along(place, surfaces.face, shadowOffset(frame, t, place))};
}

/// Sets rays off from surfaces in directions of their own; facets of smooth surfaces that turn
/// away from them are left as in SunShadow.h.
inline void setOff(const FrameSetup& frame, const RayPacket& packet, const SurfaceLanes& surfaces,
                   const StartLanes& start, const LaneVectors& direction, const LaneMask& look,
                   RTCRay16& ray) {
    setOrigin(ray, start.off);
    setDirection(ray, direction);
    const LaneMask turned_away = packet.hit & look & (dot(surfaces.face, direction) < 0.25F);
    if (any(turned_away))
        liftTurnedAway(frame, packet, surfaces, bits(turned_away), ray);
}

/// What arrives of sixteen shadow rays where see-through surfaces colour it.
[[gnu::noinline]] LaneColors throughTintedPanes(const FrameSetup& frame, float shadow,
                                                const LaneMask& look, RTCRay16& ray) {
    TintedLight light;
    startTintedLight(frame, light, ray);
    rtcOccluded16(look.data(), frame.scene, &light.context, &ray);
    const LaneMask ended = load(ray.tfar) < 0.0F;
    const auto channel = [&](int c) {
        alignas(64) float passed[lane_count];
        for (int i = 0; i < lane_count; ++i)
            passed[i] = light.passed[c][i];
        const Lanes kept_off = select(ended, Lanes(1.0F), Lanes(1.0F) - load(passed));
        return select(look, Lanes(1.0F) - kept_off * shadow, 1.0F);
    };
    return {channel(0), channel(1), channel(2)};
}

/// The part of the light that arrives at surfaces from places or directions, by channel.
/// @param toward   where it comes from; `reach` is in lengths of it
/// @param reach    how far the light is away; `unlimited` for what is infinitely far
/// @param shadow   how much of the light a shadow takes away, 0 to 1
/// @param look     the lanes that ask; others get 1
inline LaneColors lightReaching(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const StartLanes& start,
                                const LaneVectors& toward, const Lanes& reach, float shadow,
                                const LaneMask& look) {
    const LaneMask asked = look & reachesBox(frame, start.place, toward);
    if (!frame.scene || shadow <= 0.0F || !any(asked))
        return {1.0F, 1.0F, 1.0F};
    RTCRay16 ray;
    prepare(ray);
    setOff(frame, packet, surfaces, start, toward, asked, ray);
    store(ray.tfar, select(asked, reach, no_distance));
    if (frame.has_see_through)
        return throughTintedPanes(frame, shadow, asked, ray);
    // Not coherent: occlusion packets of partly masked rays do not end there in Embree 3.13.
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(asked.data(), frame.scene, &context, &ray);
    const Lanes arriving = select(asked & (load(ray.tfar) < 0.0F), 1.0F - shadow, 1.0F);
    return {arriving, arriving, arriving};
}

} // namespace
} // namespace quarn
