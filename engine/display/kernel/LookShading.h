#pragma once

#include "engine/display/ShownLight.h"
#include "engine/display/kernel/LookLanes.h"
#include "engine/display/kernel/SurfaceShading.h"

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

/// The light that surfaces send to the observer by what they look like.
[[gnu::noinline]] inline LaneColors shadeLooks(const FrameSetup& frame, const RayPacket& packet,
                                               const SurfaceLanes& surfaces, const LaneMask& lit) {
    const LaneColors matt = shadeSurfaces(frame, packet, surfaces, lit);
    LookLanes looks;
    if (!readLooks(frame, packet, surfaces, looks))
        return matt;
    const LaneColors sent{matt.r + looks.emission.r, matt.g + looks.emission.g,
                          matt.b + looks.emission.b};
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
