#pragma once

#include "engine/display/kernel/Background.h"
#include "engine/display/kernel/GroundPlane.h"
#include "engine/display/kernel/LookShading.h"

namespace quarn {
namespace {

/// Opaque surfaces and the ground, shaded together so that they share one packet of shadow rays.
/// @param through  see sentLight
inline LaneColors shadeOpaque(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                              LaneColors* through = nullptr) {
    const LaneMask missed = packet.active & ~packet.hit;
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
    LaneColors shaded = sentLight(frame, packet, surfaces, lit, through);
    if (frame.free_sky && frame.hides_sky_of_ground_alone)
        shaded = shaded * skyArriving(frame, packet, surfaces, ground.seen);
    color = blended(color, shaded, ground.weight);
    return select(packet.hit, shaded, color);
}

} // namespace
} // namespace quarn
