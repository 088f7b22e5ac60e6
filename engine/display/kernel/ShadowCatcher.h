#pragma once

#include "engine/display/kernel/Background.h"
#include "engine/display/kernel/Displayed.h"
#include "engine/display/kernel/GroundPlane.h"
#include "engine/display/kernel/LookShading.h"

namespace quarn {
namespace {

/// The light that arrives on open ground, where nothing stands before any light.
/// @param place  on the ground
inline LaneColors lightOnOpenGround(const FrameSetup& frame, const LaneVectors& place) {
    const LaneVectors up{0.0F, 0.0F, 1.0F};
    LaneColors light = ambientLight(frame, up);
    addFixedLights(frame, up, light);
    for (int k = 0; k < frame.sun_count; ++k)
        addLight(frame.suns[k].color, greatest(Lanes(frame.suns[k].toward[2]), 0.0F), light);
    for (int k = 0; k < frame.lamp_count; ++k) {
        const LampLanes seen = lampAt(frame.lamps[k], place);
        addLight(frame.lamps[k].color, seen.amount * greatest(seen.toward.z, 0.0F), light);
    }
    return light;
}

/// Less than this no step of a channel tells apart.
constexpr float least_shade = 0.004F;

/// How much of the light is kept off where rays met the ground: 0 to 1, the same for all colours so
/// that a shadow takes that of what it falls on.
/// @param arriving  the light that arrives there
inline Lanes shadeOnGround(const FrameSetup& frame, const RayPacket& packet,
                           const GroundLanes& ground, const LaneColors& arriving) {
    const Lanes t = select(ground.seen, packet.distance, 0.0F);
    const LaneColors open = lightOnOpenGround(frame, along(packet.origin(), packet.direction(), t));
    const Lanes kept =
        (arriving.r + arriving.g + arriving.b) / greatest(open.r + open.g + open.b, 1e-12F);
    const Lanes shade = (Lanes(1.0F - least_shade) - kept) * (1.0F / (1.0F - least_shade));
    return select(ground.seen, clamped(shade) * ground.weight, 0.0F);
}

/// The background where a shadow lies on it.
inline LaneColors shadedBackground(const FrameSetup& frame, const RayPacket& packet,
                                   const LaneColors& background, const Lanes& shade) {
    if (frame.has_clear_background)
        return background;
    const LaneMask shaded = shade > 0.0F;
    if (!any(shaded))
        return background;
    const Lanes left = Lanes(1.0F) - shade;
    // What is shown as white may stand for any light: there a shadow takes from what is shown.
    const LaneColors darker =
        frame.has_sky
            ? background * left
            : lightShownAs(frame,
                           gradient(frame, packet.y, frame.shown_top, frame.shown_bottom) * left);
    return select(shaded, darker, background);
}

/// How opaque a black shadow is before nothing. Pictures are laid over each other by the numbers of
/// their pixels, so a shadow is as dark as it is on white when these are.
[[gnu::noinline]] inline Lanes opacityOfShade(const FrameSetup& frame, const Lanes& shade) {
    const Lanes left = Lanes(1.0F) - shade;
    const Lanes number = floatsOf(displayed(frame, lightShownAs(frame, {left, left, left}).r));
    return select(shade > 0.0F, Lanes(1.0F) - number * (1.0F / 255.0F), 0.0F);
}

} // namespace
} // namespace quarn
