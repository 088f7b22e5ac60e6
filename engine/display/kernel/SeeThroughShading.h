#pragma once

#include "engine/display/kernel/OpaqueShading.h"
#include "engine/display/kernel/PaneOpacity.h"

namespace quarn {
namespace {

/// The surface that a ray meets behind so many see-through ones is drawn as if it were opaque.
constexpr int most_panes = 16;

/// Light that would change no pixel by a step is not looked for.
constexpr float least_light = 1.0F / 512.0F;

/// Sends the rays of `packet.active` on, behind what they met.
inline void goOn(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces) {
    // Faces that lie on each other count as one everywhere, not now one and now two.
    const Lanes beyond = packet.distance * 1.00002F + 1e-5F * frame.scene_size;
    store(packet.rays.ray.tnear, select(packet.active, beyond, 0.0F));
    intersect(frame, packet);
    readSurfaces(frame, packet, surfaces);
}

/// Lays what stands behind see-through surfaces under them, each as opaque as its material says.
/// @param packet    holds the first hits
/// @param nearness  of the first hits; takes that of the last surface which each ray met, so that
///   lines are seen through panes
/// @param cover     see shadeOpaque
[[gnu::noinline]] inline LaneColors shadeThroughPanes(const FrameSetup& frame, RayPacket& packet,
                                                      SurfaceLanes& surfaces, Lanes& nearness,
                                                      Lanes* cover) {
    const LaneMask active = packet.active;
    LaneColors left{1.0F, 1.0F, 1.0F}; // what still comes through
    LaneColors sum{0.0F, 0.0F, 0.0F};
    Lanes covered = 1.0F;
    for (int pane = 0;; ++pane) {
        const Lanes opacity = pane < most_panes ? paneOpacities(frame, packet, surfaces) : 1.0F;
        const Lanes near = nearnessOf(frame, packet);
        const LaneMask hit = packet.hit;
        LaneColors through{0.0F, 0.0F, 0.0F};
        const LaneColors shaded = shadeOpaque(frame, packet, surfaces, &through, cover);
        const LaneColors part = left * select(packet.active, opacity, 0.0F);
        sum = sum + part * shaded;
        if (cover)
            covered = covered - mean(part) * (Lanes(1.0F) - *cover);
        left = left - part;
        if (pane + 1 < most_panes)
            left = left + part * through;
        const LaneMask seen =
            (left.r > least_light) | (left.g > least_light) | (left.b > least_light);
        const LaneMask goes_on = packet.active & hit & seen;
        nearness = select(packet.active & ~goes_on, near, nearness);
        packet.active = goes_on;
        if (!any(goes_on))
            break;
        goOn(frame, packet, surfaces);
    }
    store(packet.rays.ray.tnear, 0.0F);
    packet.active = active;
    if (cover)
        *cover = covered;
    return sum;
}

} // namespace
} // namespace quarn
