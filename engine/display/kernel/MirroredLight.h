#pragma once

#include "engine/display/kernel/Microfacets.h"
#include "engine/display/kernel/OneSided.h"
#include "engine/display/kernel/PaneOpacity.h"

namespace quarn {
namespace {

/// The light that surfaces send to the observer by what they look like.
/// @param sends_rays  whether mirrors show the scene; those that are seen in mirrors do not
/// @param through     takes the part of the light from behind that glass lets through; null where
///   nobody looks behind it: then what lies around shines through
[[gnu::noinline, maybe_unused]] LaneColors shadeLooks(const FrameSetup& frame,
                                                      const RayPacket& packet,
                                                      SurfaceLanes surfaces, const LaneMask& lit,
                                                      bool sends_rays, LaneColors* through);

/// Sends a ray from each lane of `wanted` to where it mirrors.
inline void aimMirrors(const FrameSetup& frame, const RayPacket& packet,
                       const SurfaceLanes& surfaces, const LaneVectors& direction,
                       const LaneMask& wanted, RayPacket& rays) {
    prepare(rays.rays.ray);
    rays.x = packet.x;
    rays.y = packet.y;
    const Lanes t = select(wanted, packet.distance, 0.0F);
    const LaneVectors place = along(packet.origin(), packet.direction(), t);
    setOrigin(rays.rays.ray, along(place, surfaces.face, shadowOffset(frame, t, place)));
    setDirection(rays.rays.ray, direction);
    rays.active = wanted;
    intersectFronts(frame, rays);
}

/// What rays from mirrors see, where `around` lies behind the scene. They see the first pane alone.
inline LaneColors sceneInMirrors(const FrameSetup& frame, RayPacket& rays,
                                 const LaneColors& around) {
    SurfaceLanes met;
    readSurfaces(frame, rays, met);
    Lanes weight = 0.0F;
    if (mirrorsGround(frame))
        weight = meetGround(frame, rays, met).weight;
    weight = select(rays.hit, Lanes(1.0F), weight);
    if (frame.has_see_through)
        weight = weight * paneOpacities(frame, rays, met);
    const LaneMask lit = weight > 0.0F;
    if (!any(lit))
        return around;
    return blended(around, shadeLooks(frame, rays, met, lit, false, nullptr), weight);
}

/// The light that comes to the surfaces from where they mirror.
/// @param sending  the lanes that may see the scene
inline LaneColors mirroredLight(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const MirrorLanes& mirrors,
                                const LaneMask& sending, const Lanes& occlusion) {
    const LaneColors around =
        mirroredSurroundings(frame, mirrors.direction, mirrors.roughness) * occlusion;
    const LaneMask sharp = sending & (mirrors.roughness < roughness_of_surroundings);
    if (!any(sharp))
        return around;
    RayPacket rays;
    aimMirrors(frame, packet, surfaces, mirrors.direction, sharp, rays);
    constexpr float fade = 1.0F / (roughness_of_surroundings - roughness_of_scene);
    const Lanes sharpness = clamped((Lanes(roughness_of_surroundings) - mirrors.roughness) * fade);
    return blended(around, sceneInMirrors(frame, rays, around), select(sharp, sharpness, 0.0F));
}

} // namespace
} // namespace quarn
