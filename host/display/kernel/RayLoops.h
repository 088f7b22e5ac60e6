// The ray loops. Each RayKernel_*.cpp includes this once, with its own processor's flags.

#include "host/display/DisplayTable.h"
#include "host/display/kernel/LayeredShading.h"
#include "host/display/kernel/SeeThroughShading.h"
#include "host/display/kernel/SkyLoops.h"

namespace quarn {
namespace {

/// The display table's byte for each lane.
inline LaneInts displayed(const FrameSetup& frame, const Lanes& light) {
    const LaneInts place = shiftedRight(bitsOf(greatest(light, 0.0F)), DisplayTable::shift) -
                           LaneInts(DisplayTable::first);
    const LaneInts from_0 = select(place > LaneInts(0), place, LaneInts(0));
    const LaneInts last(DisplayTable::count - 1);
    return gathered(frame.display_table, select(from_0 > last, last, from_0));
}

inline LaneInts encoded(const FrameSetup& frame, const LaneColors& color) {
    return displayed(frame, color.r) | shiftedLeft(displayed(frame, color.g), 8) |
           shiftedLeft(displayed(frame, color.b), 16) |
           LaneInts(static_cast<std::int32_t>(0xFF000000U));
}

struct TracedPacket {
    LaneInts pixels;
    LaneInts objects;
    Lanes nearness;
};

/// What the packet met first.
inline TracedPacket firstMet(const FrameSetup& frame, const RayPacket& packet,
                             SurfaceLanes& surfaces) {
    readSurfaces(frame, packet, surfaces);
    TracedPacket traced;
    traced.objects = select(packet.hit, surfaces.surface + LaneInts(1), LaneInts(0));
    traced.nearness = nearnessOf(frame, packet);
    return traced;
}

/// Finds what aimed rays see where every surface lets some of what is behind it through.
[[gnu::noinline]] TracedPacket traceLayers(const FrameSetup& frame, RayPacket& packet) {
    LayerHits hits(frame, packet);
    hits.next(frame, packet, 0.0F);
    SurfaceLanes surfaces;
    TracedPacket traced = firstMet(frame, packet, surfaces);
    traced.pixels = encoded(frame, shadeLayers(frame, packet, hits, surfaces));
    return traced;
}

/// Shoots the packet's rays and finds the colours that they see.
inline TracedPacket trace(const FrameSetup& frame, RayPacket& packet) {
    aim(frame, packet);
    if (frame.layers.count > 1)
        return traceLayers(frame, packet);
    intersect(frame, packet);
    SurfaceLanes surfaces;
    TracedPacket traced = firstMet(frame, packet, surfaces);
    if (frame.has_see_through)
        traced.pixels = encoded(frame, shadeThroughPanes(frame, packet, surfaces, traced.nearness));
    else
        traced.pixels = encoded(frame, shadeOpaque(frame, packet, surfaces));
    return traced;
}

struct TilePlace {
    int x;
    int y;
    int columns;
    int rows;
};

/// @param values  the sixteen of a tile, row by row; T has four bytes
template <class T>
inline void storeTile(const T* values, T* image, int width, const TilePlace& place) {
    for (int row = 0; row < place.rows; ++row) {
        T* const to = image +
                      static_cast<std::size_t>(place.y + row) * static_cast<std::size_t>(width) +
                      static_cast<std::size_t>(place.x);
        const T* const from = values + tile_size * row;
        if (place.columns == tile_size) {
            __builtin_memcpy(to, from, tile_size * sizeof(T));
            continue;
        }
        for (int column = 0; column < place.columns; ++column)
            to[column] = from[column];
    }
}

inline void storeTile(const LaneInts& values, std::uint32_t* image, int width,
                      const TilePlace& place) {
    alignas(64) std::uint32_t plain[lane_count];
    store(plain, values);
    storeTile(plain, image, width, place);
}

inline void storeTile(const Lanes& values, float* image, int width, const TilePlace& place) {
    alignas(64) float plain[lane_count];
    store(plain, values);
    storeTile(plain, image, width, place);
}

inline int smaller(int a, int b) {
    return a < b ? a : b;
}

/// Calls function(packet, place) for each tile of a block, with the packet's places set.
template <class Function>
inline void forEachTile(const PixelBlock& block, const Function& function) {
    alignas(64) constexpr float columns[lane_count] = {0.5F, 1.5F, 2.5F, 3.5F, 0.5F, 1.5F,
                                                       2.5F, 3.5F, 0.5F, 1.5F, 2.5F, 3.5F,
                                                       0.5F, 1.5F, 2.5F, 3.5F};
    alignas(64) constexpr float rows[lane_count] = {0.5F, 0.5F, 0.5F, 0.5F, 1.5F, 1.5F, 1.5F, 1.5F,
                                                    2.5F, 2.5F, 2.5F, 2.5F, 3.5F, 3.5F, 3.5F, 3.5F};
    const Lanes column = load(columns);
    const Lanes row = load(rows);
    RayPacket packet;
    prepare(packet.rays.ray);
    for (int y = block.y_begin; y < block.y_end; y += tile_size) {
        for (int x = block.x_begin; x < block.x_end; x += tile_size) {
            const TilePlace place{x, y, smaller(tile_size, block.x_end - x),
                                  smaller(tile_size, block.y_end - y)};
            packet.x = column + static_cast<float>(x);
            packet.y = row + static_cast<float>(y);
            packet.active = (column < static_cast<float>(place.columns)) &
                            (row < static_cast<float>(place.rows));
            function(packet, place);
        }
    }
}

void traceBlock(const FrameSetup& frame, const PixelBlock& block) {
    forEachTile(block, [&](RayPacket& packet, const TilePlace& place) {
        const TracedPacket traced = trace(frame, packet);
        storeTile(traced.pixels, frame.pixels, frame.width, place);
        if (frame.nearness)
            storeTile(traced.nearness, frame.nearness, frame.width, place);
        if (frame.objects)
            storeTile(traced.objects, frame.objects, frame.width, place);
    });
}

void traceSamples(const FrameSetup& frame, SamplePacket& samples) {
    alignas(64) float lane[lane_count];
    for (int i = 0; i < lane_count; ++i)
        lane[i] = static_cast<float>(i);
    RayPacket packet;
    prepare(packet.rays.ray);
    packet.x = load(samples.x);
    packet.y = load(samples.y);
    packet.active = load(lane) < static_cast<float>(samples.count);
    const TracedPacket traced = trace(frame, packet);
    store(samples.pixels, traced.pixels);
    store(samples.objects, traced.objects);
}

} // namespace

extern const RayKernel QUARN_RAY_KERNEL;
const RayKernel QUARN_RAY_KERNEL{QUARN_RAY_KERNEL_NAME, traceBlock, traceSamples, findFreeSky};

} // namespace quarn
