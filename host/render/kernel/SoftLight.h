#pragma once

#include "host/display/kernel/Background.h"
#include "host/display/kernel/GroundPlane.h"
#include "host/display/kernel/SurfaceShading.h"
#include "host/render/kernel/Directions.h"

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
    const LaneVectors place = along(packet.origin, packet.direction, t);
    return {place, along(place, surfaces.face, shadowOffset(frame, t, place))};
}

/// Sets rays off from surfaces in directions of their own; facets of smooth surfaces that turn
/// away from them are left as in SunShadow.h.
inline void setOff(const FrameSetup& frame, const RayPacket& packet, const SurfaceLanes& surfaces,
                   const StartLanes& start, const LaneVectors& direction, const LaneMask& look,
                   RTCRay16& ray) {
    setOrigin(ray, start.off);
    setDirection(ray, direction);
    const LaneMask turned_away = packet.hit & look & (dot(surfaces.face, direction) < Lanes(0.25F));
    if (any(turned_away))
        liftTurnedAway(frame, packet, surfaces, bits(turned_away), ray);
}

/// The part of a sun's light that arrives from one place of its disc.
inline Lanes softSunArriving(const RenderSetup& setup, int index, const RayPacket& packet,
                             const SurfaceLanes& surfaces, const StartLanes& start,
                             const LaneMask& lit, const DiscLanes& disc) {
    const FrameSetup& frame = setup.frame;
    const FrameLight& sun = frame.suns[index];
    if (!frame.scene || sun.shadow <= 0.0F)
        return 1.0F;
    const float(&across)[3] = setup.discs[index].across;
    const float(&up)[3] = setup.discs[index].along;
    const LaneVectors toward{disc.x * across[0] + disc.y * up[0] + sun.toward[0],
                             disc.x * across[1] + disc.y * up[1] + sun.toward[1],
                             disc.x * across[2] + disc.y * up[2] + sun.toward[2]};
    const LaneMask look = lit & reachesBox(frame, start.place, toward);
    if (!any(look))
        return 1.0F;
    RTCRay16 ray;
    prepare(ray);
    setOff(frame, packet, surfaces, start, toward, look, ray);
    store(ray.tfar, select(look, unlimited, no_distance));
    // Not coherent: occlusion packets of partly masked rays do not end there in Embree 3.13.
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(look.data(), frame.scene, &context, &ray);
    return select(look & (load(ray.tfar) < 0.0F), 1.0F - sun.shadow, 1.0F);
}

/// Light of all suns on the lit lanes, before albedo.
inline LaneColors sunLight(const RenderSetup& setup, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const StartLanes& start,
                           const LaneMask& lit, const LanePlaces& place) {
    LaneColors light{0.0F, 0.0F, 0.0F};
    const DiscLanes disc = onDisc(place);
    for (int k = 0; k < setup.frame.sun_count; ++k) {
        const FrameLight& sun = setup.frame.suns[k];
        const Lanes facing = greatest(dot(surfaces.normal, sun.toward), 0.0F);
        const Lanes arriving =
            softSunArriving(setup, k, packet, surfaces, start, lit & (facing > 0.0F), disc);
        addLight(sun.color, facing * arriving, light);
    }
    return light;
}

/// What the sky sheds from where a ray that met nothing went.
inline LaneColors domeColors(const RenderSetup& setup, const RayPacket& packet) {
    const LaneColors sky = skyColors(setup.bounce, packet);
    return {sky.r * setup.sky_scale[0], sky.g * setup.sky_scale[1], sky.b * setup.sky_scale[2]};
}

/// The light that comes to the lit lanes from one direction each: of the sky, or of the surface or
/// ground that stands before it, which is shaded as in a drawing.
/// @param bounce  prepared; holds the rays afterwards
inline LaneColors skyLight(const RenderSetup& setup, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const StartLanes& start,
                           const LaneMask& lit, const LanePlaces& place, RayPacket& bounce) {
    const FrameSetup& frame = setup.bounce;
    const LaneVectors around = aroundNormals(surfaces.normal, place);
    // A direction below the very triangle is turned to the other side of it.
    const Lanes below = least(dot(around, surfaces.face), 0.0F);
    bounce.direction = along(around, surfaces.face, below * -2.0F);
    bounce.active = lit & reachesBox(frame, start.off, bounce.direction);
    setOff(frame, packet, surfaces, start, bounce.direction, bounce.active, bounce.rays.ray);
    bounce.origin = {load(bounce.rays.ray.org_x), load(bounce.rays.ray.org_y),
                     load(bounce.rays.ray.org_z)};
    intersect(frame, bounce, RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
    bounce.active = lit;
    const LaneMask missed = lit & ~bounce.hit;
    LaneColors color = any(missed) ? domeColors(setup, bounce) : LaneColors{0.0F, 0.0F, 0.0F};
    SurfaceLanes met;
    readSurfaces(frame, bounce, met);
    Lanes weight = select(bounce.hit, 1.0F, 0.0F);
    if (frame.has_ground && any(missed))
        weight = greatest(weight, meetGround(frame, bounce, met).weight);
    const LaneMask shaded = lit & (weight > 0.0F);
    if (!any(shaded))
        return color;
    const LaneColors surface = shadeSurfaces(frame, bounce, met, shaded);
    const LaneColors mixed{color.r + weight * (surface.r - color.r),
                           color.g + weight * (surface.g - color.g),
                           color.b + weight * (surface.b - color.b)};
    return select(shaded, mixed, color);
}

} // namespace
} // namespace quarn
