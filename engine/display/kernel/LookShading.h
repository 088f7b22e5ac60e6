#pragma once

#include "engine/display/ShownLight.h"
#include "engine/display/kernel/LookLanes.h"
#include "engine/display/kernel/Microfacets.h"
#include "engine/display/kernel/PaneOpacity.h"

namespace quarn {
namespace {

/// The scene light that is shown as these colours.
inline LaneColors lightShownAs(const FrameSetup& frame, const LaneColors& colors) {
    const auto channel = [&](const Lanes& shown) {
        const LaneInts step =
            wholePart(clamped(shown) * static_cast<float>(ShownLight::steps) + 0.5F);
        return floatsWith(gathered(frame.shown_light, step));
    };
    return {channel(colors.r), channel(colors.g), channel(colors.b)};
}

/// What metals mirror has their colour; what others do, mostly none.
inline MirrorLanes mirrorsOf(const FrameSetup& frame, const RayPacket& packet,
                             const SurfaceLanes& surfaces, const LookNumbers<Lanes>& look) {
    MirrorLanes mirrors;
    mirrors.f0 = blended({look.f0[0], look.f0[1], look.f0[2]}, surfaces.albedo, look.metalness);
    mirrors.f90 = look.f90 + look.metalness * (Lanes(1.0F) - look.f90);
    mirrors.roughness = look.roughness;
    findMirrors(frame, packet, surfaces, surfaces.normal, mirrors);
    return mirrors;
}

/// The light that surfaces send to the observer by what they look like.
/// @param sends_rays  whether mirrors show the scene; those that are seen in mirrors do not
[[gnu::noinline, maybe_unused]] LaneColors shadeLooks(const FrameSetup& frame,
                                                      const RayPacket& packet,
                                                      SurfaceLanes surfaces, const LaneMask& lit,
                                                      bool sends_rays);

/// Up to the first roughness mirrors show the scene itself, from the second on what lies around.
constexpr float roughness_of_scene = 0.2F;
constexpr float roughness_of_surroundings = 0.4F;

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
    intersect(frame, rays, RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
}

/// What rays from mirrors see, where `around` lies behind the scene. They see the first pane alone.
inline LaneColors sceneInMirrors(const FrameSetup& frame, RayPacket& rays,
                                 const LaneColors& around) {
    SurfaceLanes met;
    readSurfaces(frame, rays, met);
    Lanes weight = 0.0F;
    if (frame.has_ground)
        weight = meetGround(frame, rays, met).weight;
    weight = select(rays.hit, Lanes(1.0F), weight);
    if (frame.has_see_through)
        weight = weight * paneOpacities(frame, rays, met);
    const LaneMask lit = weight > 0.0F;
    if (!any(lit))
        return around;
    return blended(around, shadeLooks(frame, rays, met, lit, false), weight);
}

/// The light that comes to the surfaces from where they mirror.
inline LaneColors mirroredLight(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const MirrorLanes& mirrors,
                                const LaneMask& wanted, const Lanes& occlusion) {
    const LaneColors around =
        mirroredSurroundings(frame, mirrors.direction, mirrors.roughness) * occlusion;
    const LaneMask sharp = wanted & (mirrors.roughness < roughness_of_surroundings);
    if (!any(sharp))
        return around;
    RayPacket rays;
    aimMirrors(frame, packet, surfaces, mirrors.direction, sharp, rays);
    constexpr float fade = 1.0F / (roughness_of_surroundings - roughness_of_scene);
    const Lanes sharpness = clamped((Lanes(roughness_of_surroundings) - mirrors.roughness) * fade);
    return blended(around, sceneInMirrors(frame, rays, around), select(sharp, sharpness, 0.0F));
}

/// Surfaces none of which mirrors.
inline LaneColors shadeMatt(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LookNumbers<Lanes>& look,
                            const LaneMask& lit) {
    LaneColors light = skyLight(frame, packet, surfaces, lit) * look.occlusion;
    addFixedLights(frame, surfaces.normal, light);
    addSuns(frame, packet, surfaces, lit, light, [](const auto&...) {});
    return surfaces.albedo * light;
}

/// Surfaces some of which mirror. What they mirror is no longer there to be scattered.
inline LaneColors shadeMirrors(const FrameSetup& frame, const RayPacket& packet,
                               const SurfaceLanes& surfaces, const LookNumbers<Lanes>& look,
                               const LaneMask& lit, const LaneMask& sending) {
    const MirrorLanes mirrors = mirrorsOf(frame, packet, surfaces, look);
    const LaneColors sky = skyLight(frame, packet, surfaces, lit) * look.occlusion;
    LaneColors light = sky;
    addFixedLights(frame, surfaces.normal, light);
    LaneColors spots{0.0F, 0.0F, 0.0F};
    addSuns(frame, packet, surfaces, lit, light,
            [&](const FrameLight& sun, const Lanes& facing, const Lanes& arriving) {
                spots = spots + highlight(mirrors, surfaces.normal, sun.toward, facing) *
                                    uniformColor(sun.color) * arriving;
            });
    const LaneColors mirrored =
        mirroredLight(frame, packet, surfaces, mirrors, sending, look.occlusion);
    const auto left = [&](const Lanes& first, const Lanes& further) {
        return (Lanes(1.0F) - look.metalness) * (Lanes(1.0F) - first - further);
    };
    const LaneColors scattered{left(mirrors.first.r, mirrors.further.r),
                               left(mirrors.first.g, mirrors.further.g),
                               left(mirrors.first.b, mirrors.further.b)};
    return surfaces.albedo * scattered * light + mirrors.first * mirrored + mirrors.further * sky +
           spots;
}

[[gnu::noinline, maybe_unused]] LaneColors shadeLooks(const FrameSetup& frame,
                                                      const RayPacket& packet,
                                                      SurfaceLanes surfaces, const LaneMask& lit,
                                                      bool sends_rays) {
    LookLanes looks;
    if (!readLooks(frame, packet, surfaces, looks))
        return shadeSurfaces(frame, packet, surfaces, lit);
    const LookNumbers<Lanes>& look = looks.numbers;
    const LaneMask sending = sends_rays ? looks.mirrors & lit : noLanes();
    LaneColors sent = frame.has_mirrors && any(looks.mirrors)
                          ? shadeMirrors(frame, packet, surfaces, look, lit, sending)
                          : shadeMatt(frame, packet, surfaces, look, lit);
    sent = sent + LaneColors{look.emission[0], look.emission[1], look.emission[2]};
    if (!any(looks.unlit))
        return sent;
    return select(looks.unlit, lightShownAs(frame, surfaces.albedo), sent);
}

/// The light that surfaces send to the observer, in the lanes of `lit`.
inline LaneColors sentLight(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LaneMask& lit) {
    return frame.has_looks ? shadeLooks(frame, packet, surfaces, lit, true)
                           : shadeSurfaces(frame, packet, surfaces, lit);
}

} // namespace
} // namespace quarn
