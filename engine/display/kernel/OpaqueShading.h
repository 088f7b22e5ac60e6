#pragma once

#include "engine/display/kernel/LookShading.h"
#include "engine/display/kernel/ShadowCatcher.h"

namespace quarn {
namespace {

/// Ground that looks as what is behind it, with the shadows that lie on it.
/// @param behind  takes the shadows
/// @return how much of the light is kept off
inline Lanes shadeCatcher(const FrameSetup& frame, const RayPacket& packet,
                          const GroundLanes& ground, const LaneColors& shaded, LaneColors& behind) {
    const float(&albedo)[3] = frame.ground_albedo;
    const LaneColors arriving =
        shaded * LaneColors{1.0F / albedo[0], 1.0F / albedo[1], 1.0F / albedo[2]};
    const Lanes shade = shadeOnGround(frame, packet, ground, arriving);
    behind = shadedBackground(frame, packet, behind, shade);
    return shade;
}

/// Opaque surfaces and the ground, shaded together so that they share one packet of shadow rays.
/// @param through  see sentLight
/// @param cover    takes how opaque what is seen is, where the background is clear; else null
inline LaneColors shadeOpaque(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                              LaneColors* through = nullptr, Lanes* cover = nullptr) {
    const LaneMask missed = packet.active & ~packet.hit;
    if (cover)
        *cover = select(packet.hit, 1.0F, 0.0F);
    if (!any(missed))
        return sentLight(frame, packet, surfaces, packet.hit, through);
    LaneColors color = backgroundColors(frame, packet);
    if (!frame.has_ground) {
        if (!any(packet.hit))
            return color;
        return select(packet.hit, sentLight(frame, packet, surfaces, packet.hit, through), color);
    }
    const GroundLanes ground = meetGround(frame, packet, surfaces);
    const LaneMask lit = packet.hit | ground.seen;
    if (!any(lit))
        return color;
    const LaneColors shaded = sentLight(frame, packet, surfaces, lit, through);
    if (!frame.catches_shadows) {
        color = blended(color, shaded, ground.weight);
    } else {
        const Lanes shade = shadeCatcher(frame, packet, ground, shaded, color);
        if (cover)
            *cover = select(packet.hit, Lanes(1.0F), opacityOfShade(frame, shade));
    }
    return select(packet.hit, shaded, color);
}

} // namespace
} // namespace quarn
