#pragma once

#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// Reads the opacity of one surface where it varies.
inline void readVariedOpacity(const FrameSetup& frame, const RaySurface& surface,
                              const RayPacket& packet, unsigned lanes_meant, Lanes& opacity) {
    float* const lanes = reinterpret_cast<float*>(opacity.part);
    for (; lanes_meant != 0; lanes_meant &= lanes_meant - 1) {
        const int i = __builtin_ctz(lanes_meant);
        const float place[3] = {packet.rays.hit.u[i], packet.rays.hit.v[i],
                                packet.rays.ray.tfar[i]};
        lanes[i] = paneOpacityAt(frame, surface, packet.rays, i, place);
    }
}

/// How opaque the surfaces are that the rays met: 1 but for see-through materials.
inline Lanes paneOpacities(const FrameSetup& frame, const RayPacket& packet,
                           const SurfaceLanes& surfaces) {
    Lanes opacity = 1.0F;
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces.surface);
    unsigned rest = bits(packet.hit);
    while (rest != 0) {
        const std::uint32_t index = met[__builtin_ctz(rest)];
        const LaneMask mask =
            packet.hit & (surfaces.surface == LaneInts(static_cast<std::int32_t>(index)));
        rest &= ~bits(mask);
        const RaySurface& surface = frame.surfaces[index];
        if (!surface.see_through)
            continue;
        if (surface.colors || surface.texture)
            readVariedOpacity(frame, surface, packet, bits(mask), opacity);
        else
            opacity = select(mask, Lanes(surface.opacity), opacity);
    }
    return opacity;
}

} // namespace
} // namespace quarn
