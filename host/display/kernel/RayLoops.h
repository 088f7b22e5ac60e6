// The ray loops. Each RayKernel_*.cpp includes this once, with its own processor's flags.

#include "host/display/ColorSpace.h"
#include "host/display/kernel/Background.h"
#include "host/display/kernel/GroundPlane.h"
#include "host/display/kernel/SurfaceShading.h"

namespace quarn {
namespace {

inline std::uint32_t displayIndex(float light) {
    const auto bits = __builtin_bit_cast(std::int32_t, greatest(light, 0.0F));
    const std::int32_t place = (bits >> DisplayTable::shift) - DisplayTable::first;
    const std::int32_t from_0 = place > 0 ? place : 0;
    return static_cast<std::uint32_t>(from_0 < DisplayTable::count ? from_0
                                                                   : DisplayTable::count - 1);
}

inline void encode(const FrameSetup& frame, const LaneColors& color,
                   std::uint32_t (&pixels)[lane_count]) {
    const std::uint32_t* const table = frame.display_table;
    for (int i = 0; i < lane_count; ++i)
        pixels[i] = table[displayIndex(color.r.v[i])] | table[displayIndex(color.g.v[i])] << 8 |
                    table[displayIndex(color.b.v[i])] << 16 | 0xFF000000U;
}

/// color = under * (1 - weight) + over * weight, in the lanes of `mask`; else `under`. What the
/// other lanes of `over` hold is not looked at: it may be no number.
inline void blendOver(const LaneColors& over, const Lanes& weight, const LaneMask& mask,
                      LaneColors& under) {
    for (int i = 0; i < lane_count; ++i) {
        const float w = mask.v[i] ? weight.v[i] : 0.0F;
        const float r = under.r.v[i] + w * (over.r.v[i] - under.r.v[i]);
        const float g = under.g.v[i] + w * (over.g.v[i] - under.g.v[i]);
        const float b = under.b.v[i] + w * (over.b.v[i] - under.b.v[i]);
        under.r.v[i] = mask.v[i] ? r : under.r.v[i];
        under.g.v[i] = mask.v[i] ? g : under.g.v[i];
        under.b.v[i] = mask.v[i] ? b : under.b.v[i];
    }
}

inline void select(const LaneColors& chosen, const LaneMask& mask, LaneColors& color) {
    for (int i = 0; i < lane_count; ++i) {
        color.r.v[i] = mask.v[i] ? chosen.r.v[i] : color.r.v[i];
        color.g.v[i] = mask.v[i] ? chosen.g.v[i] : color.g.v[i];
        color.b.v[i] = mask.v[i] ? chosen.b.v[i] : color.b.v[i];
    }
}

/// Opaque surfaces and the ground, shaded together so that they share one packet of shadow rays.
inline void shadeOpaque(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                        LaneColors& color) {
    LaneMask lit = packet.hit;
    GroundLanes ground;
    bool ground_seen = false;
    bool background_seen = false;
    for (int i = 0; i < lane_count; ++i)
        background_seen |= packet.active.v[i] && !packet.hit.v[i];
    if (frame.has_ground && background_seen) {
        meetGround(frame, packet, surfaces, ground);
        ground_seen = any(ground.seen);
        for (int i = 0; i < lane_count; ++i)
            lit.v[i] |= ground.seen.v[i];
    }
    if (background_seen)
        backgroundColors(frame, packet, color);
    if (!any(lit))
        return;
    LaneColors shaded;
    shadeSurfaces(frame, packet, surfaces, lit, shaded);
    if (ground_seen)
        blendOver(shaded, ground.weight, ground.seen, color);
    if (background_seen)
        select(shaded, packet.hit, color);
    else
        color = shaded;
}

/// How opaque see-through surfaces are: the more, the more they are seen along their face.
inline void layerOpacity(const FrameSetup& frame, const RayPacket& packet,
                         const SurfaceLanes& surfaces, Lanes& opacity) {
    const RTCRay16& ray = packet.rays.ray;
    for (int i = 0; i < lane_count; ++i) {
        const float x = ray.dir_x[i];
        const float y = ray.dir_y[i];
        const float z = ray.dir_z[i];
        const float along = absolute(surfaces.normal.x.v[i] * x + surfaces.normal.y.v[i] * y +
                                     surfaces.normal.z.v[i] * z);
        const float turned = 1.0F - clamped(along / squareRoot(x * x + y * y + z * z));
        opacity.v[i] =
            frame.layers.facing_opacity +
            turned * turned * turned * (frame.layers.edge_on_opacity - frame.layers.facing_opacity);
    }
}

/// Lays one surface after the other under what was seen so far.
inline void shadeLayers(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                        LaneColors& color) {
    Lanes left; // what still comes through
    LaneColors sum{};
    const LaneMask active = packet.active;
    for (int i = 0; i < lane_count; ++i)
        left.v[i] = 1.0F;
    for (int layer = 0; layer < frame.layers.count && any(packet.hit); ++layer) {
        LaneColors shaded;
        Lanes opacity;
        shadeSurfaces(frame, packet, surfaces, packet.hit, shaded);
        layerOpacity(frame, packet, surfaces, opacity);
        for (int i = 0; i < lane_count; ++i) {
            const float part = packet.hit.v[i] ? left.v[i] * opacity.v[i] : 0.0F;
            sum.r.v[i] += part * shaded.r.v[i];
            sum.g.v[i] += part * shaded.g.v[i];
            sum.b.v[i] += part * shaded.b.v[i];
            left.v[i] -= part;
            packet.active.v[i] = packet.hit.v[i] && left.v[i] > 0.02F ? -1 : 0;
            const float reached = packet.rays.ray.tfar[i];
            packet.rays.ray.tnear[i] =
                packet.active.v[i] ? reached * 1.00002F + 1e-5F * frame.scene_size : 0.0F;
        }
        aim(frame, packet);
        intersect(frame, packet);
        readSurfaces(frame, packet, surfaces);
    }
    packet.active = active;
    backgroundColors(frame, packet, color);
    for (int i = 0; i < lane_count; ++i) {
        color.r.v[i] = sum.r.v[i] + left.v[i] * color.r.v[i];
        color.g.v[i] = sum.g.v[i] + left.v[i] * color.g.v[i];
        color.b.v[i] = sum.b.v[i] + left.v[i] * color.b.v[i];
        packet.rays.ray.tnear[i] = 0.0F;
    }
}

struct TracedPacket {
    alignas(64) std::uint32_t pixels[lane_count];
    alignas(64) std::uint32_t objects[lane_count];
    Lanes nearness;
};

/// Shoots the packet's rays and finds the colours that they see.
inline void trace(const FrameSetup& frame, RayPacket& packet, bool wants_nearness,
                  TracedPacket& traced) {
    aim(frame, packet);
    intersect(frame, packet);
    if (wants_nearness)
        nearnessOf(frame, packet, traced.nearness);
    LaneColors color;
    SurfaceLanes surfaces;
    readSurfaces(frame, packet, surfaces);
    for (int i = 0; i < lane_count; ++i)
        traced.objects[i] = packet.hit.v[i] ? surfaces.surface[i] + 1 : 0;
    if (frame.layers.count > 1)
        shadeLayers(frame, packet, surfaces, color);
    else
        shadeOpaque(frame, packet, surfaces, color);
    encode(frame, color, traced.pixels);
}

template <class T>
inline void storeTile(const T* values, T* image, int width, int x, int y, int columns, int rows) {
    for (int row = 0; row < rows; ++row) {
        T* const to = image + static_cast<std::size_t>(y + row) * static_cast<std::size_t>(width) +
                      static_cast<std::size_t>(x);
        for (int column = 0; column < columns; ++column)
            to[column] = values[tile_size * row + column];
    }
}

inline void store(const FrameSetup& frame, const TracedPacket& traced, int x, int y, int columns,
                  int rows) {
    storeTile(traced.pixels, frame.pixels, frame.width, x, y, columns, rows);
    if (frame.nearness)
        storeTile(traced.nearness.v, frame.nearness, frame.width, x, y, columns, rows);
    if (frame.objects)
        storeTile(traced.objects, frame.objects, frame.width, x, y, columns, rows);
}

void traceBlock(const FrameSetup& frame, const PixelBlock& block) {
    RayPacket packet;
    TracedPacket traced;
    prepare(packet);
    for (int y = block.y_begin; y < block.y_end; y += tile_size) {
        for (int x = block.x_begin; x < block.x_end; x += tile_size) {
            const int columns = block.x_end - x < tile_size ? block.x_end - x : tile_size;
            const int rows = block.y_end - y < tile_size ? block.y_end - y : tile_size;
            for (int i = 0; i < lane_count; ++i) {
                const int column = i % tile_size;
                const int row = i / tile_size;
                packet.x.v[i] = static_cast<float>(x + column) + 0.5F;
                packet.y.v[i] = static_cast<float>(y + row) + 0.5F;
                packet.active.v[i] = column < columns && row < rows ? -1 : 0;
            }
            trace(frame, packet, frame.nearness != nullptr, traced);
            store(frame, traced, x, y, columns, rows);
        }
    }
}

void traceSamples(const FrameSetup& frame, SamplePacket& samples) {
    RayPacket packet;
    TracedPacket traced;
    prepare(packet);
    for (int i = 0; i < lane_count; ++i) {
        const bool meant = i < samples.count;
        packet.x.v[i] = meant ? samples.x[i] : 0.0F;
        packet.y.v[i] = meant ? samples.y[i] : 0.0F;
        packet.active.v[i] = meant ? -1 : 0;
    }
    trace(frame, packet, false, traced);
    for (int i = 0; i < lane_count; ++i) {
        samples.pixels[i] = traced.pixels[i];
        samples.objects[i] = traced.objects[i];
    }
}

} // namespace

extern const RayKernel QUARN_RAY_KERNEL;
const RayKernel QUARN_RAY_KERNEL{QUARN_RAY_KERNEL_NAME, traceBlock, traceSamples};

} // namespace quarn
