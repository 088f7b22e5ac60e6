#pragma once

#include "engine/display/kernel/GroundPlane.h"
#include "engine/display/kernel/SkyGrid.h"

namespace quarn {
namespace {

/// A tile of 4 by 4 places of the grid.
struct GridPlaces {
    Lanes column;
    Lanes row;
};

inline void keepFreeSky(const FrameSetup& frame, const GridPlaces& places, const LaneMask& active,
                        const SkyKnown& found) {
    alignas(64) float column[lane_count];
    alignas(64) float row[lane_count];
    alignas(64) float values[7][lane_count];
    store(column, places.column);
    store(row, places.row);
    store(values[0], found.normal.x);
    store(values[1], found.normal.y);
    store(values[2], found.normal.z);
    store(values[3], found.point.x);
    store(values[4], found.point.y);
    store(values[5], found.point.z);
    store(values[6], found.free);
    for (unsigned rest = bits(active); rest != 0; rest &= rest - 1) {
        const int i = __builtin_ctz(rest);
        const auto place =
            static_cast<std::size_t>(row[i]) * static_cast<std::size_t>(frame.sky_width) +
            static_cast<std::size_t>(column[i]);
        frame.sky_places[place] = {{values[0][i], values[1][i], values[2][i]},
                                   {values[3][i], values[4][i], values[5][i]}};
        frame.free_sky[place] = values[6][i];
    }
}

inline void findFreeSky(const FrameSetup& frame, const GridPlaces& places, RayPacket& packet) {
    packet.x = (places.column + 0.5F) * static_cast<float>(sky_spacing);
    packet.y = (places.row + 0.5F) * static_cast<float>(sky_spacing);
    packet.active = (places.column < static_cast<float>(frame.sky_width)) &
                    (places.row < static_cast<float>(frame.sky_height));
    if (!any(packet.active))
        return;
    aim(frame, packet);
    intersect(frame, packet);
    SurfaceLanes surfaces;
    readSurfaces(frame, packet, surfaces);
    LaneMask seen = packet.hit;
    if (frame.has_ground)
        seen = seen | meetGround(frame, packet, surfaces).seen;
    const SkyPoints points = skyPoints(frame, packet, surfaces, seen);
    const LaneVectors point =
        along(packet.origin(), packet.direction(), select(seen, packet.distance, 0.0F));
    keepFreeSky(frame, places, packet.active,
                {select(seen, surfaces.normal, LaneVectors{0.0F, 0.0F, 0.0F}), point,
                 freeSky(frame, points)});
}

void findFreeSky(const FrameSetup& frame, const PixelBlock& block) {
    alignas(64) constexpr float columns[lane_count] = {0, 1, 2, 3, 0, 1, 2, 3,
                                                       0, 1, 2, 3, 0, 1, 2, 3};
    alignas(64) constexpr float rows[lane_count] = {0, 0, 0, 0, 1, 1, 1, 1, 2, 2, 2, 2, 3, 3, 3, 3};
    const Lanes column = load(columns);
    const Lanes row = load(rows);
    RayPacket packet;
    prepare(packet.rays.ray);
    for (int y = block.y_begin; y < block.y_end; y += tile_size)
        for (int x = block.x_begin; x < block.x_end; x += tile_size)
            findFreeSky(frame, {column + static_cast<float>(x), row + static_cast<float>(y)},
                        packet);
}

} // namespace
} // namespace quarn
