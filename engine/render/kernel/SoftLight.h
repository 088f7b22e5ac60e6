#pragma once

#include "engine/display/kernel/SeeThroughShading.h"
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
    const LaneMask turned_away = packet.hit & look & (dot(surfaces.face, direction) < Lanes(0.25F));
    if (any(turned_away))
        liftTurnedAway(frame, packet, surfaces, bits(turned_away), ray);
}

/// Aims shadow rays at one place of a sun's disc.
/// @return the lanes that have to look
inline LaneMask aimAtSun(const RenderSetup& setup, int index, const RayPacket& packet,
                         const SurfaceLanes& surfaces, const StartLanes& start, const LaneMask& lit,
                         const DiscLanes& disc, RTCRay16& ray) {
    const FrameSetup& frame = setup.frame;
    const FrameLight& sun = frame.suns[index];
    const float(&across)[3] = setup.discs[index].across;
    const float(&up)[3] = setup.discs[index].along;
    const LaneVectors toward{disc.x * across[0] + disc.y * up[0] + sun.toward[0],
                             disc.x * across[1] + disc.y * up[1] + sun.toward[1],
                             disc.x * across[2] + disc.y * up[2] + sun.toward[2]};
    const LaneMask look = lit & reachesBox(frame, start.place, toward);
    if (!any(look))
        return look;
    prepare(ray);
    setOff(frame, packet, surfaces, start, toward, look, ray);
    store(ray.tfar, select(look, unlimited, no_distance));
    return look;
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

/// The part of a sun's light that arrives from one place of its disc.
inline LaneColors softSunArriving(const RenderSetup& setup, int index, const RayPacket& packet,
                                  const SurfaceLanes& surfaces, const StartLanes& start,
                                  const LaneMask& lit, const DiscLanes& disc) {
    const FrameSetup& frame = setup.frame;
    const float shadow = frame.suns[index].shadow;
    if (!frame.scene || shadow <= 0.0F)
        return {1.0F, 1.0F, 1.0F};
    RTCRay16 ray;
    const LaneMask look = aimAtSun(setup, index, packet, surfaces, start, lit, disc, ray);
    if (!any(look))
        return {1.0F, 1.0F, 1.0F};
    if (frame.has_see_through)
        return throughTintedPanes(frame, shadow, look, ray);
    // Not coherent: occlusion packets of partly masked rays do not end there in Embree 3.13.
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(look.data(), frame.scene, &context, &ray);
    const Lanes arriving = select(look & (load(ray.tfar) < 0.0F), 1.0F - shadow, 1.0F);
    return {arriving, arriving, arriving};
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
        const LaneColors arriving =
            softSunArriving(setup, k, packet, surfaces, start, lit & (facing > 0.0F), disc);
        light.r = light.r + facing * arriving.r * sun.color[0];
        light.g = light.g + facing * arriving.g * sun.color[1];
        light.b = light.b + facing * arriving.b * sun.color[2];
    }
    return light;
}

/// What the sky sheds from where a ray that met nothing went.
inline LaneColors domeColors(const RenderSetup& setup, const RayPacket& packet) {
    const LaneColors sky = skyColors(setup.bounce, packet);
    return {sky.r * setup.sky_scale[0], sky.g * setup.sky_scale[1], sky.b * setup.sky_scale[2]};
}

/// What rays see in the direction in which each was sent: the sky, or the surface or the ground
/// that stands before it, which is shaded as in a drawing.
/// @param met  the surfaces; takes the ground
inline LaneColors seenAround(const RenderSetup& setup, RayPacket& bounce, SurfaceLanes& met) {
    const FrameSetup& frame = setup.bounce;
    const LaneMask missed = bounce.active & ~bounce.hit;
    LaneColors color = any(missed) ? domeColors(setup, bounce) : LaneColors{0.0F, 0.0F, 0.0F};
    Lanes weight = select(bounce.hit, 1.0F, 0.0F);
    if (frame.has_ground && any(missed))
        weight = greatest(weight, meetGround(frame, bounce, met).weight);
    const LaneMask shaded = bounce.active & (weight > 0.0F);
    if (!any(shaded))
        return color;
    const LaneColors surface = shadeSurfaces(frame, bounce, met, shaded);
    const LaneColors mixed{color.r + weight * (surface.r - color.r),
                           color.g + weight * (surface.g - color.g),
                           color.b + weight * (surface.b - color.b)};
    return select(shaded, mixed, color);
}

/// How much light of each colour comes through panes, see passedByPane.
inline LaneColors passedByPanes(const Lanes& opacity, const LaneColors& albedo) {
    const Lanes brightest = greatest(greatest(albedo.r, albedo.g), albedo.b);
    const Lanes scale = Lanes(1.0F) / greatest(brightest, 1e-12F);
    const LaneMask has_hue = brightest > 1e-12F;
    const Lanes clear = Lanes(1.0F) - opacity;
    const auto channel = [&](const Lanes& color) {
        const Lanes hue = select(has_hue, color * scale, 1.0F);
        return clear * (Lanes(1.0F) - opacity * (Lanes(1.0F) - hue));
    };
    return {channel(albedo.r), channel(albedo.g), channel(albedo.b)};
}

/// What rays see where they go on behind see-through surfaces, by whose colour it is tinted.
[[gnu::noinline]] LaneColors seenThroughPanes(const RenderSetup& setup, RayPacket& bounce,
                                              SurfaceLanes& met) {
    const FrameSetup& frame = setup.bounce;
    const LaneMask active = bounce.active;
    LaneColors left{1.0F, 1.0F, 1.0F};
    LaneColors sum{0.0F, 0.0F, 0.0F};
    for (int pane = 0;; ++pane) {
        const Lanes opacity = pane < most_panes ? paneOpacities(frame, bounce, met) : 1.0F;
        const LaneColors passed = passedByPanes(opacity, met.albedo);
        const LaneMask hit = bounce.hit;
        const LaneColors seen = seenAround(setup, bounce, met);
        const Lanes part = select(bounce.active, opacity, 0.0F);
        sum = {sum.r + left.r * part * seen.r, sum.g + left.g * part * seen.g,
               sum.b + left.b * part * seen.b};
        left = {left.r * passed.r, left.g * passed.g, left.b * passed.b};
        const Lanes most = greatest(greatest(left.r, left.g), left.b);
        bounce.active = bounce.active & hit & (opacity < 1.0F) & (most > least_light);
        if (!any(bounce.active))
            break;
        const Lanes beyond = bounce.distance * 1.00002F + 1e-5F * frame.scene_size;
        store(bounce.rays.ray.tnear, select(bounce.active, beyond, 0.0F));
        intersect(frame, bounce, RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
        readSurfaces(frame, bounce, met);
    }
    store(bounce.rays.ray.tnear, 0.0F);
    bounce.active = active;
    return sum;
}

/// The light that comes to the lit lanes from one direction each: of the sky, or of what stands
/// before it.
/// @param bounce  prepared; holds the rays afterwards
inline LaneColors skyLight(const RenderSetup& setup, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const StartLanes& start,
                           const LaneMask& lit, const LanePlaces& place, RayPacket& bounce) {
    const FrameSetup& frame = setup.bounce;
    const LaneVectors around = aroundNormals(surfaces.normal, place);
    // A direction below the very triangle is turned to the other side of it.
    const Lanes below = least(dot(around, surfaces.face), 0.0F);
    const LaneVectors toward = along(around, surfaces.face, below * -2.0F);
    bounce.active = lit & reachesBox(frame, start.off, toward);
    setOff(frame, packet, surfaces, start, toward, bounce.active, bounce.rays.ray);
    intersect(frame, bounce, RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
    bounce.active = lit;
    SurfaceLanes met;
    readSurfaces(frame, bounce, met);
    if (frame.has_see_through)
        return seenThroughPanes(setup, bounce, met);
    return seenAround(setup, bounce, met);
}

} // namespace
} // namespace quarn
