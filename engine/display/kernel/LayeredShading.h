#pragma once

#include "engine/display/kernel/Background.h"
#include "engine/display/kernel/LayerHits.h"
#include "engine/display/kernel/SurfaceShading.h"

namespace quarn {
namespace {

/// How opaque see-through surfaces are: the more, the more they are seen along their face.
inline Lanes layerOpacity(const FrameSetup& frame, const RayPacket& packet,
                          const SurfaceLanes& surfaces) {
    const Lanes length = squareRoot(dot(packet.direction(), packet.direction()));
    const Lanes facing = absolute(dot(surfaces.normal, packet.direction())) / length;
    const Lanes turned = Lanes(1.0F) - clamped(facing);
    const FrameLayers& layers = frame.layers;
    return turned * turned * turned * (layers.edge_on_opacity - layers.facing_opacity) +
           layers.facing_opacity;
}

/// Stained glass: what comes through takes the colour of the surface.
inline LaneColors passed(const FrameLayers& layers, const LaneColors& left, const Lanes& opacity,
                         const LaneColors& albedo) {
    const auto channel = [&](const Lanes& before, const Lanes& color) {
        const Lanes stained = Lanes(1.0F) - (Lanes(1.0F) - color) * layers.stain;
        return before * (Lanes(1.0F) - opacity) * stained;
    };
    return {channel(left.r, albedo.r), channel(left.g, albedo.g), channel(left.b, albedo.b)};
}

/// Keeps how near the layer is, for the lines behind it.
inline void keepLayer(const FrameSetup& frame, const RayPacket& packet, int layer) {
    alignas(64) float x[lane_count];
    alignas(64) float y[lane_count];
    alignas(64) float nearness[lane_count];
    store(x, packet.x);
    store(y, packet.y);
    store(nearness, nearnessOf(frame, packet));
    const unsigned active = bits(packet.active);
    for (int i = 0; i < lane_count; ++i) {
        if (!(active >> i & 1U))
            continue;
        const auto pixel = static_cast<std::size_t>(y[i]) * static_cast<std::size_t>(frame.width) +
                           static_cast<std::size_t>(x[i]);
        frame.layer_nearness[pixel * layers_kept + static_cast<std::size_t>(layer)] = nearness[i];
    }
}

/// Lays one surface after the other under what was seen so far.
/// @param packet  holds the first of `hits`, and `surfaces` what they are
/// @param cover   see shadeOpaque
inline LaneColors shadeLayers(const FrameSetup& frame, RayPacket& packet, LayerHits& hits,
                              SurfaceLanes& surfaces, Lanes* cover) {
    const LaneMask active = packet.active;
    LaneColors left{1.0F, 1.0F, 1.0F}; // what still comes through
    LaneColors sum{0.0F, 0.0F, 0.0F};
    for (int layer = 0; layer < frame.layers.count && any(packet.hit); ++layer) {
        if (frame.layer_nearness && layer < layers_kept)
            keepLayer(frame, packet, layer);
        const LaneColors shaded = shadeSurfaces(frame, packet, surfaces, packet.hit);
        const Lanes part = select(packet.hit, layerOpacity(frame, packet, surfaces), 0.0F);
        sum = {sum.r + left.r * part * shaded.r, sum.g + left.g * part * shaded.g,
               sum.b + left.b * part * shaded.b};
        left = select(packet.hit, passed(frame.layers, left, part, surfaces.albedo), left);
        const LaneMask seen =
            (left.r > Lanes(0.02F)) | (left.g > Lanes(0.02F)) | (left.b > Lanes(0.02F));
        packet.active = packet.hit & seen;
        // Faces that lie on each other count as one layer everywhere, not now one and now two.
        const Lanes beyond = packet.distance * 1.00002F + 1e-5F * frame.scene_size;
        hits.next(frame, packet, beyond);
        readSurfaces(frame, packet, surfaces);
    }
    packet.active = active;
    if (cover)
        *cover = Lanes(1.0F) - mean(left);
    const LaneColors behind = backgroundColors(frame, packet);
    return {sum.r + left.r * behind.r, sum.g + left.g * behind.g, sum.b + left.b * behind.b};
}

} // namespace
} // namespace quarn
