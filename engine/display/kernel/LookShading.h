#pragma once

#include "engine/display/ShownLight.h"
#include "engine/display/kernel/MirrorShading.h"

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

/// Surfaces none of which mirrors.
inline LaneColors shadeMatt(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LookNumbers<Lanes>& look,
                            const LaneMask& lit) {
    LaneColors light = skyLight(frame, packet, surfaces, lit) * look.occlusion;
    addFixedLights(frame, surfaces.normal, light);
    NoMirrors none;
    addLights(frame, packet, surfaces, lit, light, none);
    return surfaces.albedo * light + emissionOf(frame, look);
}

LaneColors shadeLooks(const FrameSetup& frame, const RayPacket& packet, SurfaceLanes surfaces,
                      const LaneMask& lit, bool sends_rays, LaneColors* through) {
    LookLanes looks;
    if (!readLooks(frame, packet, surfaces, looks))
        return shadeSurfaces(frame, packet, surfaces, lit);
    const LaneColors sent =
        frame.has_mirrors && any(looks.mirrors)
            ? shadeMirrors(frame, packet, surfaces, looks, lit, sends_rays, through)
            : shadeMatt(frame, packet, surfaces, looks.numbers, lit);
    if (!any(looks.unlit))
        return sent;
    return select(looks.unlit, lightShownAs(frame, surfaces.albedo), sent);
}

/// The light that surfaces send to the observer, in the lanes of `lit`.
/// @param through  takes the part of the light from behind that glass lets through, where there is
///   any; null where nobody looks behind it
inline LaneColors sentLight(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LaneMask& lit,
                            LaneColors* through) {
    return frame.has_looks ? shadeLooks(frame, packet, surfaces, lit, true, through)
                           : shadeSurfaces(frame, packet, surfaces, lit);
}

} // namespace
} // namespace quarn
