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
                             const SurfaceLanes& surfaces, const LookLanes& looks) {
    MirrorLanes mirrors;
    mirrors.f0 = blended(looks.f0, surfaces.albedo, looks.metalness);
    mirrors.f90 = looks.f90 + looks.metalness * (Lanes(1.0F) - looks.f90);
    mirrors.roughness = looks.roughness;
    findMirrors(frame, packet, surfaces.normal, mirrors);
    return mirrors;
}

/// Surfaces some of which mirror. What they mirror is no longer there to be scattered.
inline LaneColors shadeMirrors(const FrameSetup& frame, const RayPacket& packet,
                               const SurfaceLanes& surfaces, const LookLanes& looks,
                               const LaneMask& lit) {
    const MirrorLanes mirrors = mirrorsOf(frame, packet, surfaces, looks);
    const LaneColors sky = skyLight(frame, packet, surfaces, lit);
    LaneColors light = sky;
    addFixedLights(frame, surfaces.normal, light);
    LaneColors shine{0.0F, 0.0F, 0.0F};
    for (int k = 0; k < frame.sun_count; ++k) {
        const FrameLight& sun = frame.suns[k];
        const Lanes facing = greatest(dot(surfaces.normal, sun.toward), 0.0F);
        const Lanes arriving = sunlightArriving(frame, sun, packet, surfaces, lit, facing);
        addLight(sun.color, facing * arriving, light);
        const LaneColors spot = highlight(mirrors, surfaces.normal, sun.toward, facing);
        shine = {shine.r + spot.r * arriving * sun.color[0],
                 shine.g + spot.g * arriving * sun.color[1],
                 shine.b + spot.b * arriving * sun.color[2]};
    }
    const LaneColors around = mirroredSurroundings(frame, mirrors.direction, mirrors.roughness);
    const Lanes matt = Lanes(1.0F) - looks.metalness;
    const auto channel = [&](const Lanes& albedo, const Lanes& arrived, const Lanes& first,
                             const Lanes& further, const Lanes& mirrored, const Lanes& even,
                             const Lanes& spots) {
        return albedo * matt * (Lanes(1.0F) - first - further) * arrived + first * mirrored +
               further * even + spots;
    };
    const LaneColors& first = mirrors.first;
    const LaneColors& further = mirrors.further;
    return {channel(surfaces.albedo.r, light.r, first.r, further.r, around.r, sky.r, shine.r),
            channel(surfaces.albedo.g, light.g, first.g, further.g, around.g, sky.g, shine.g),
            channel(surfaces.albedo.b, light.b, first.b, further.b, around.b, sky.b, shine.b)};
}

/// The light that surfaces send to the observer by what they look like.
[[gnu::noinline]] inline LaneColors shadeLooks(const FrameSetup& frame, const RayPacket& packet,
                                               const SurfaceLanes& surfaces, const LaneMask& lit) {
    LookLanes looks;
    if (!readLooks(frame, packet, surfaces, looks))
        return shadeSurfaces(frame, packet, surfaces, lit);
    LaneColors sent = frame.has_mirrors && any(looks.mirrors)
                          ? shadeMirrors(frame, packet, surfaces, looks, lit)
                          : shadeSurfaces(frame, packet, surfaces, lit);
    sent = {sent.r + looks.emission.r, sent.g + looks.emission.g, sent.b + looks.emission.b};
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
