#pragma once

#include "engine/display/ShownLight.h"
#include "engine/display/kernel/LookLanes.h"
#include "engine/display/kernel/Microfacets.h"

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
    findMirrors(frame, packet, surfaces.normal, mirrors);
    return mirrors;
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
                               const LaneMask& lit) {
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
    const LaneColors around =
        mirroredSurroundings(frame, mirrors.direction, mirrors.roughness) * look.occlusion;
    const auto left = [&](const Lanes& first, const Lanes& further) {
        return (Lanes(1.0F) - look.metalness) * (Lanes(1.0F) - first - further);
    };
    const LaneColors scattered{left(mirrors.first.r, mirrors.further.r),
                               left(mirrors.first.g, mirrors.further.g),
                               left(mirrors.first.b, mirrors.further.b)};
    return surfaces.albedo * scattered * light + mirrors.first * around + mirrors.further * sky +
           spots;
}

/// The light that surfaces send to the observer by what they look like.
[[gnu::noinline]] inline LaneColors shadeLooks(const FrameSetup& frame, const RayPacket& packet,
                                               SurfaceLanes surfaces, const LaneMask& lit) {
    LookLanes looks;
    if (!readLooks(frame, packet, surfaces, looks))
        return shadeSurfaces(frame, packet, surfaces, lit);
    const LookNumbers<Lanes>& look = looks.numbers;
    LaneColors sent = frame.has_mirrors && any(looks.mirrors)
                          ? shadeMirrors(frame, packet, surfaces, look, lit)
                          : shadeMatt(frame, packet, surfaces, look, lit);
    sent = sent + LaneColors{look.emission[0], look.emission[1], look.emission[2]};
    if (!any(looks.unlit))
        return sent;
    return select(looks.unlit, lightShownAs(frame, surfaces.albedo), sent);
}

/// The light that surfaces send to the observer, in the lanes of `lit`.
inline LaneColors sentLight(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LaneMask& lit) {
    return frame.has_looks ? shadeLooks(frame, packet, surfaces, lit)
                           : shadeSurfaces(frame, packet, surfaces, lit);
}

} // namespace
} // namespace quarn
