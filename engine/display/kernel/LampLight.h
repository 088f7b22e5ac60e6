#pragma once

#include "engine/display/kernel/OpenSky.h"

namespace quarn {
namespace {

/// A lamp as points see it.
struct LampLanes {
    LaneVectors toward; ///< unit vectors to the lamp
    Lanes distance;
    Lanes amount; ///< of its colour on a surface that faces it, where nothing stands between
};

inline LampLanes lampAt(const FrameLamp& lamp, const LaneVectors& place) {
    constexpr float no_number_below = 1e-30F;
    const LaneVectors to{Lanes(lamp.place[0]) - place.x, Lanes(lamp.place[1]) - place.y,
                         Lanes(lamp.place[2]) - place.z};
    const Lanes square = dot(to, to);
    LampLanes seen;
    seen.distance = squareRoot(greatest(square, no_number_below));
    seen.toward = to * (Lanes(1.0F) / seen.distance);
    const Lanes cone = clamped(dot(seen.toward, lamp.axis) * -lamp.cone_slope + lamp.cone_base);
    seen.amount = cone * cone / greatest(square, lamp.least_square);
    return seen;
}

/// How far before a lamp shadow rays end: what the lamp hangs in must not hide it.
constexpr float part_to_lamp = 0.999F;

/// The part of a lamp's light that arrives at the lanes of `wanted`.
inline Lanes lamplightArriving(const FrameSetup& frame, const FrameLamp& lamp,
                               const RayPacket& packet, const SurfaceLanes& surfaces,
                               ShadowStart start, const LampLanes& seen, const LaneMask& wanted) {
    if (!frame.scene || lamp.shadow <= 0.0F)
        return 1.0F;
    const Lanes reach = seen.distance * part_to_lamp;
    start.look = wanted & reachesScene(frame, start.place, seen.toward, reach);
    if (!any(start.look))
        return 1.0F;
    return lightArriving(frame, lamp.shadow, packet, surfaces, start, seen.toward, reach);
}

/// Adds the light of the lamps.
/// @param mirrors  see addLights
template <class Mirrors>
[[gnu::noinline]] void addLamps(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const LaneMask& lit,
                                LaneColors& light, Mirrors& mirrors) {
    const ShadowStart start = shadowStart(packet, lit);
    for (int k = 0; k < frame.lamp_count; ++k) {
        const FrameLamp& lamp = frame.lamps[k];
        const LampLanes seen = lampAt(lamp, start.place);
        const Lanes facing = greatest(dot(surfaces.normal, seen.toward), 0.0F);
        const LaneMask wanted = lit & (facing * seen.amount > 0.0F);
        const LaneColors full = uniformColor(lamp.color) * select(wanted, seen.amount, 0.0F);
        if (!any(wanted))
            continue;
        const LaneMask shown = wanted & mirrors.show(full, seen.toward, facing);
        const LaneColors sent =
            full * lamplightArriving(frame, lamp, packet, surfaces, start, seen, shown);
        light = light + sent * facing;
        mirrors.add(sent);
    }
}

} // namespace
} // namespace quarn
