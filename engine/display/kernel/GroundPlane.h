#pragma once

#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// Where rays that met no surface meet the ground.
struct GroundLanes {
    LaneMask seen;
    Lanes weight; ///< how much of the ground shows through the haze, 0 to 1
};

/// Lets the rays that missed everything fall on the ground plane: sets their distance and fills
/// their lanes of `surfaces`. The ground is seen from above only, so that it never covers a model
/// that is looked at from below, and it fades out far from the model.
inline GroundLanes meetGround(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces) {
    const Lanes height = packet.origin().z - frame.ground_height;
    LaneMask downward = packet.direction().z < Lanes(-1e-5F);
    if (!frame.rays.parallel)
        downward = downward & (height > 0.0F);
    const Lanes t = height / select(downward, -packet.direction().z, 1.0F);
    const LaneVectors place = along(packet.origin(), packet.direction(), t);
    const Lanes x = place.x - frame.ground_center[0];
    const Lanes y = place.y - frame.ground_center[1];
    const float fade = 1.0F / (frame.ground_fade_end - frame.ground_fade_start);
    const Lanes s = clamped((Lanes(frame.ground_fade_end) - squareRoot(x * x + y * y)) * fade);
    GroundLanes ground;
    ground.seen = packet.active & ~packet.hit & downward & (s > 0.0F);
    ground.weight = select(ground.seen, s * s * (Lanes(3.0F) - Lanes(2.0F) * s), 0.0F);
    packet.distance = select(ground.seen, t, packet.distance);
    const LaneVectors straight_up{0.0F, 0.0F, 1.0F};
    surfaces.face = select(ground.seen, straight_up, surfaces.face);
    surfaces.normal = select(ground.seen, straight_up, surfaces.normal);
    surfaces.albedo = select(ground.seen, uniformColor(frame.ground_albedo), surfaces.albedo);
    return ground;
}

} // namespace
} // namespace quarn
