#pragma once

#include "engine/display/kernel/OpenSky.h"
#include "engine/display/kernel/SquareMaps.h"

namespace quarn {
namespace {

/// The places of the grid nearest to a packet's rays on one side, and how near they are.
struct SkyNeighbours {
    LaneInts column;
    LaneInts row;
    Lanes weight; ///< of the four on all sides, together 1
};

/// @param dx, dy  0 or 1: left or right, above or below
inline SkyNeighbours skyNeighbours(const FrameSetup& frame, const RayPacket& packet, int dx,
                                   int dy) {
    // Counted from the place before the first one, so that cutting off rounds down.
    const Lanes x = packet.x * (1.0F / sky_spacing) + 0.5F;
    const Lanes y = packet.y * (1.0F / sky_spacing) + 0.5F;
    const LaneInts column = wholePart(x);
    const LaneInts row = wholePart(y);
    const Lanes right = x - floatsOf(column);
    const Lanes below = y - floatsOf(row);
    const Lanes across = dx == 0 ? Lanes(1.0F) - right : right;
    const Lanes down = dy == 0 ? Lanes(1.0F) - below : below;
    return {limited(column + LaneInts(dx - 1), frame.sky_width - 1),
            limited(row + LaneInts(dy - 1), frame.sky_height - 1), across * down};
}

/// What the grid knows there.
struct SkyKnown {
    LaneVectors normal; ///< 0: no surface
    LaneVectors point;
    Lanes free;
};

inline SkyKnown known(const FrameSetup& frame, const SkyNeighbours& at) {
    alignas(64) std::uint32_t places[lane_count];
    alignas(64) float values[7][lane_count];
    store(places, at.row * LaneInts(frame.sky_width) + at.column);
    for (int i = 0; i < lane_count; ++i) {
        const SkyPlace& place = frame.sky_places[places[i]];
        for (int axis = 0; axis < 3; ++axis) {
            values[axis][i] = place.normal[axis];
            values[3 + axis][i] = place.point[axis];
        }
        values[6][i] = frame.free_sky[places[i]];
    }
    return {{load(values[0]), load(values[1]), load(values[2])},
            {load(values[3]), load(values[4]), load(values[5])},
            load(values[6])};
}

/// True where a place of the grid shows the surface that the packet's ray met.
inline LaneMask showSameSurface(const FrameSetup& frame, const LaneVectors& place,
                                const LaneVectors& normal, const SkyKnown& there) {
    const LaneVectors& met = there.point;
    const LaneVectors apart{met.x - place.x, met.y - place.y, met.z - place.z};
    const Lanes step = greatest(absolute(dot(normal, apart)), absolute(dot(there.normal, apart)));
    const Lanes allowed = squareRoot(dot(apart, apart)) * sky_step_of_slope +
                          Lanes(sky_step_of_reach * frame.sky_reach);
    return (dot(normal, there.normal) > sky_least_facing) & (step < allowed);
}

/// The part of the sky's light that arrives at the lit lanes. What the grid found around a pixel
/// counts as far as it shows the same surface; a pixel that it has missed looks at the sky itself.
inline Lanes skyArriving(const FrameSetup& frame, const RayPacket& packet,
                         const SurfaceLanes& surfaces, const LaneMask& lit) {
    const SkyPoints points = skyPoints(frame, packet, surfaces, lit);
    if (!any(points.wanted))
        return 1.0F;
    const LaneVectors place =
        along(packet.origin(), packet.direction(), select(lit, packet.distance, 0.0F));
    Lanes sum = 0.0F;
    Lanes weights = 0.0F;
    for (int side = 0; side < 4; ++side) {
        const SkyNeighbours at = skyNeighbours(frame, packet, side % 2, side / 2);
        const SkyKnown there = known(frame, at);
        const Lanes weight =
            select(showSameSurface(frame, place, surfaces.normal, there), at.weight, 0.0F);
        sum = sum + weight * there.free;
        weights = weights + weight;
    }
    const LaneMask found = weights > 0.01F;
    alignas(64) float free[lane_count];
    store(free, select(found & points.wanted, sum / select(found, weights, 1.0F), 1.0F));
    for (unsigned missed = bits(points.wanted & ~found); missed != 0; missed &= missed - 1) {
        const int lane = __builtin_ctz(missed);
        free[lane] = freeSkyAlone(frame, points, lane);
    }
    return load(free);
}

} // namespace
} // namespace quarn
