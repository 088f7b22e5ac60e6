#pragma once

#include "engine/display/kernel/OpenSky.h"

namespace quarn {
namespace {

/// How much of the light from all around arrives at places on the ground: 1 beyond the map.
inline Lanes openGroundAt(const FrameSetup& frame, const LaneVectors& place) {
    const FrameGroundMap& map = frame.ground_map;
    constexpr auto last = static_cast<float>(ground_map_side - 1);
    const Lanes x = (place.x - map.corner[0]) * map.texels_a_unit[0] - 0.5F;
    const Lanes y = (place.y - map.corner[1]) * map.texels_a_unit[1] - 0.5F;
    const LaneMask within = (x > 0.0F) & (y > 0.0F) & (x < last) & (y < last);
    const Lanes inner_x = select(within, x, 0.0F);
    const Lanes inner_y = select(within, y, 0.0F);
    const LaneInts column = wholePart(inner_x);
    const LaneInts row = wholePart(inner_y);
    const Lanes right = inner_x - floatsOf(column);
    const Lanes below = inner_y - floatsOf(row);
    const auto* const from = reinterpret_cast<const std::uint32_t*>(map.open);
    const LaneInts at = row * LaneInts(ground_map_side) + column;
    const auto texel = [&](int offset) { return floatsWith(gathered(from + offset, at)); };
    const Lanes upper = texel(0) + right * (texel(1) - texel(0));
    const Lanes lower =
        texel(ground_map_side) + right * (texel(ground_map_side + 1) - texel(ground_map_side));
    return select(within, upper + below * (lower - upper), 1.0F);
}

/// The part of the light from all around that arrives at the lanes of a packet: on the ground, and
/// near to it, where what faces down gets its light from ground in the shade.
inline Lanes openAboveGround(const FrameSetup& frame, const RayPacket& packet,
                             const LaneVectors& normal, const LaneMask& lit) {
    const Lanes t = select(lit, packet.distance, 0.0F);
    const LaneVectors place = along(packet.origin(), packet.direction(), t);
    const Lanes height = (place.z - frame.ground_height) * frame.ground_map.near_scale;
    const Lanes low = clamped(Lanes(1.0F) - height);
    const Lanes near = select(packet.hit, low * low, 1.0F);
    const LaneMask shaded = lit & (near > 0.0F);
    if (!any(shaded))
        return 1.0F;
    // Upright faces look at the ground before them, not at that under what they belong to.
    const LaneVectors before = along(place, normal, frame.ground_map.step_before);
    const Lanes kept_off = Lanes(1.0F) - openGroundAt(frame, before);
    const Lanes downward = select(packet.hit, Lanes(0.5F) - normal.z * 0.5F, 1.0F);
    return select(shaded, Lanes(1.0F) - kept_off * near * downward, 1.0F);
}

} // namespace
} // namespace quarn
