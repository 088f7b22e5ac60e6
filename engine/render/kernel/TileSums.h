#pragma once

#include "engine/display/kernel/SurfaceLanes.h"
#include "engine/render/kernel/RenderSetup.h"

namespace quarn {
namespace {

/// The sums of one tile while its samples are taken.
struct TileSums {
    Lanes plane[RenderPlane::count];

    void add(int at, const Lanes& value) { plane[at] = plane[at] + value; }
    void add(int at, const LaneColors& value) {
        add(at, value.r);
        add(at + 1, value.g);
        add(at + 2, value.b);
    }
};

inline void addSurfaces(const FrameSetup& frame, const RayPacket& packet,
                        const SurfaceLanes& surfaces, const Lanes& weight, TileSums& sums) {
    const Lanes near = frame.rays.parallel ? Lanes(frame.rays.far_depth) - packet.distance
                                           : Lanes(1.0F) / packet.distance;
    sums.add(RenderPlane::nearness, select(weight > 0.0F, weight * near, 0.0F));
    sums.add(RenderPlane::normal_x, weight * surfaces.normal.x);
    sums.add(RenderPlane::normal_y, weight * surfaces.normal.y);
    sums.add(RenderPlane::normal_z, weight * surfaces.normal.z);
    sums.add(RenderPlane::cover, weight);
}

} // namespace
} // namespace quarn
