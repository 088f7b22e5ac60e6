#pragma once

#include "host/display/kernel/Background.h"
#include "host/display/kernel/SurfaceShading.h"

namespace quarn {
namespace {

/// How opaque see-through surfaces are: the more, the more they are seen along their face.
inline Lanes layerOpacity(const FrameSetup& frame, const RayPacket& packet,
                          const SurfaceLanes& surfaces) {
    const Lanes length = squareRoot(dot(packet.direction, packet.direction));
    const Lanes facing = absolute(dot(surfaces.normal, packet.direction)) / length;
    const Lanes turned = Lanes(1.0F) - clamped(facing);
    const FrameLayers& layers = frame.layers;
    return turned * turned * turned * (layers.edge_on_opacity - layers.facing_opacity) +
           layers.facing_opacity;
}

/// Lays one surface after the other under what was seen so far. `packet` holds the first hits.
inline LaneColors shadeLayers(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces) {
    const LaneMask active = packet.active;
    Lanes left = 1.0F; // what still comes through
    LaneColors sum{0.0F, 0.0F, 0.0F};
    for (int layer = 0; layer < frame.layers.count && any(packet.hit); ++layer) {
        const LaneColors shaded = shadeSurfaces(frame, packet, surfaces, packet.hit);
        const Lanes part = select(packet.hit, left * layerOpacity(frame, packet, surfaces), 0.0F);
        sum = {sum.r + part * shaded.r, sum.g + part * shaded.g, sum.b + part * shaded.b};
        left = left - part;
        packet.active = packet.hit & (left > 0.02F);
        // Faces that lie on each other count as one layer everywhere, not now one and now two.
        const Lanes beyond = packet.distance * 1.00002F + 1e-5F * frame.scene_size;
        store(packet.rays.ray.tnear, select(packet.active, beyond, 0.0F));
        intersect(frame, packet);
        readSurfaces(frame, packet, surfaces);
    }
    store(packet.rays.ray.tnear, 0.0F);
    packet.active = active;
    const LaneColors behind = backgroundColors(frame, packet);
    return {sum.r + left * behind.r, sum.g + left * behind.g, sum.b + left * behind.b};
}

} // namespace
} // namespace quarn
