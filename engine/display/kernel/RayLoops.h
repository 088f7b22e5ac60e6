// The ray loops. Each RayKernel_*.cpp includes this once, with its own processor's flags.

#include "engine/display/kernel/Displayed.h"
#include "engine/display/kernel/EnvironmentLoops.h"
#include "engine/display/kernel/LayeredShading.h"
#include "engine/display/kernel/OneSided.h"
#include "engine/display/kernel/OpenGroundLoop.h"
#include "engine/display/kernel/PixelSteps.h"
#include "engine/display/kernel/SeeThroughShading.h"
#include "engine/display/kernel/SkyLoops.h"

#include <cstddef>

namespace quarn {
namespace {

inline LaneInts encoded(const FrameSetup& frame, const LaneColors& color) {
    return displayed(frame, color.r) | shiftedLeft(displayed(frame, color.g), 8) |
           shiftedLeft(displayed(frame, color.b), 16) |
           LaneInts(static_cast<std::int32_t>(0xFF000000U));
}

/// Pixels with an opacity of their own, whose colour is not multiplied by it.
/// @param color  what is seen before black
/// @param cover  how opaque it is
[[gnu::noinline]] LaneInts encodedBeforeNothing(const FrameSetup& frame, const LaneColors& color,
                                                const Lanes& cover) {
    // What glass mirrors is seen, too, where it lets everything through.
    const Lanes brightest = greatest(greatest(color.r, color.g), color.b);
    const Lanes opacity = clamped(greatest(cover, brightest));
    const LaneInts alpha = wholePart(opacity * 255.0F + 0.5F);
    const LaneMask seen = alpha > LaneInts(0);
    const LaneInts opaque = encoded(frame, color * (Lanes(1.0F) / select(seen, opacity, 1.0F)));
    const LaneInts shown = (opaque & LaneInts(0xFFFFFF)) | shiftedLeft(alpha, 24);
    return select(seen, shown, LaneInts(0));
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
    if (frame.nearness || frame.has_see_through)
        traced.nearness = nearnessOf(frame, packet);
    return traced;
}

/// Finds what aimed rays see where every surface lets some of what is behind it through.
[[gnu::noinline]] TracedPacket traceLayers(const FrameSetup& frame, RayPacket& packet) {
    LayerHits hits(frame, packet);
    hits.next(frame, packet, 0.0F);
    SurfaceLanes surfaces;
    TracedPacket traced = firstMet(frame, packet, surfaces);
    if (frame.has_clear_background) {
        Lanes cover;
        const LaneColors color = shadeLayers(frame, packet, hits, surfaces, &cover);
        traced.pixels = encodedBeforeNothing(frame, color, cover);
    } else {
        traced.pixels = encoded(frame, shadeLayers(frame, packet, hits, surfaces, nullptr));
    }
    return traced;
}

/// What rays that met surfaces see before a clear background.
[[gnu::noinline]] LaneInts shadeBeforeNothing(const FrameSetup& frame, RayPacket& packet,
                                              SurfaceLanes& surfaces, Lanes& nearness) {
    Lanes cover;
    const LaneColors color = frame.has_see_through
                                 ? shadeThroughPanes(frame, packet, surfaces, nearness, &cover)
                                 : shadeOpaque(frame, packet, surfaces, nullptr, &cover);
    return encodedBeforeNothing(frame, color, cover);
}

/// Shoots the packet's rays and finds the colours that they see.
inline TracedPacket trace(const FrameSetup& frame, RayPacket& packet) {
    aim(frame, packet);
    if (frame.layers.count > 1)
        return traceLayers(frame, packet);
    intersectFronts(frame, packet);
    SurfaceLanes surfaces;
    TracedPacket traced = firstMet(frame, packet, surfaces);
    if (frame.has_clear_background)
        traced.pixels = shadeBeforeNothing(frame, packet, surfaces, traced.nearness);
    else if (frame.has_see_through)
        traced.pixels =
            encoded(frame, shadeThroughPanes(frame, packet, surfaces, traced.nearness, nullptr));
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

/// @param values  the sixteen of a tile, row by row; numbers of four bytes
template <class T>
inline void storePartOfTile(const T* values, T* image, int width, const TilePlace& place) {
    for (int row = 0; row < place.rows; ++row)
        for (int column = 0; column < place.columns; ++column)
            image[row * std::ptrdiff_t{width} + column] = values[tile_size * row + column];
}

template <class LanesOfTile, class T>
inline void storeTile(const LanesOfTile& values, T* image, int width, const TilePlace& place) {
    const auto pitch = std::ptrdiff_t{width};
    T* const to = image + place.y * pitch + place.x;
    const T* const from = reinterpret_cast<const T*>(values.part);
    if (place.columns < tile_size || place.rows < tile_size)
        return storePartOfTile(from, to, width, place);
    for (int row = 0; row < tile_size; ++row)
        __builtin_memcpy(to + row * pitch, from + tile_size * row, tile_size * sizeof(T));
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
const RayKernel QUARN_RAY_KERNEL{
    QUARN_RAY_KERNEL_NAME, traceBlock,      traceSamples,    findSteps,
    findFreeSky,           findEnvironment, findLightAround, findOpenGround};

} // namespace quarn
