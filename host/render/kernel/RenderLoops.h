// The render loops. Each RenderKernel_*.cpp includes this once, with its own processor's flags.

#include "host/render/kernel/FilterLoop.h"
#include "host/render/kernel/SoftLight.h"

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

inline LaneColors operator*(const LaneColors& a, const LaneColors& b) {
    return {a.r * b.r, a.g * b.g, a.b * b.b};
}
inline LaneColors operator*(const LaneColors& a, const Lanes& s) {
    return {a.r * s, a.g * s, a.b * s};
}

/// Rec. 709 luminance.
inline Lanes luminance(const LaneColors& c) {
    return c.r * 0.2126F + c.g * 0.7152F + c.b * 0.0722F;
}

/// Light of the lights that cast no shadow.
inline LaneColors fixedLight(const FrameSetup& frame, const SurfaceLanes& surfaces) {
    LaneColors light{0.0F, 0.0F, 0.0F};
    for (int k = 0; k < frame.fixed_count; ++k)
        addLight(frame.fixed[k].color, greatest(dot(surfaces.normal, frame.fixed[k].toward), 0.0F),
                 light);
    return light;
}

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

/// One sample of each pixel of a tile.
inline void addSample(const RenderSetup& setup, const TileSamples& samples, std::uint32_t reversed,
                      RayPacket& packet, RayPacket& bounce, TileSums& sums) {
    const FrameSetup& frame = setup.frame;
    aim(frame, packet);
    intersect(frame, packet);
    SurfaceLanes surfaces;
    readSurfaces(frame, packet, surfaces);
    Lanes weight = select(packet.hit, 1.0F, 0.0F);
    if (any(packet.active & ~packet.hit)) {
        if (frame.has_ground)
            weight = greatest(weight, meetGround(frame, packet, surfaces).weight);
        sums.add(RenderPlane::direct_r, backgroundColors(frame, packet) * (Lanes(1.0F) - weight));
    }
    const LaneMask lit = packet.active & (weight > 0.0F);
    if (!any(lit))
        return;
    weight = select(lit, weight, 0.0F);
    const LaneColors albedo = surfaces.albedo * weight;
    const StartLanes start = startLanes(frame, packet, surfaces, lit);
    const LaneColors sky =
        skyLight(setup, packet, surfaces, start, lit,
                 placesAt(setup.samples, samples, SampleUse::sky_dome, reversed), bounce);
    const LaneColors sun =
        sunLight(setup, packet, surfaces, start, lit,
                 placesAt(setup.samples, samples, SampleUse::sun_disc, reversed));
    const Lanes sky_light = luminance(sky);
    const Lanes sun_light = luminance(sun);
    sums.add(RenderPlane::direct_r, albedo * fixedLight(frame, surfaces));
    sums.add(RenderPlane::albedo_r, albedo);
    sums.add(RenderPlane::sky_r, albedo * sky);
    sums.add(RenderPlane::sun_r, albedo * sun);
    sums.add(RenderPlane::sky_square, weight * sky_light * sky_light);
    sums.add(RenderPlane::sun_square, weight * sun_light * sun_light);
    addSurfaces(frame, packet, surfaces, weight, sums);
}

/// The upper left corners of a tile's pixels.
struct TileCorners {
    Lanes x;
    Lanes y;
};

inline TileCorners tileCorners() {
    alignas(64) constexpr float columns[lane_count] = {0, 1, 2, 3, 0, 1, 2, 3,
                                                       0, 1, 2, 3, 0, 1, 2, 3};
    alignas(64) constexpr float rows[lane_count] = {0, 0, 0, 0, 1, 1, 1, 1, 2, 2, 2, 2, 3, 3, 3, 3};
    return {load(columns), load(rows)};
}

inline void renderTile(const RenderSetup& setup, const TileCorners& corners, int first, int end,
                       const TileSamples& samples, RayPacket& packet, RayPacket& bounce,
                       TileSums& sums) {
    for (int index = first; index < end; ++index) {
        const std::uint32_t reversed = reversedBits(static_cast<std::uint32_t>(index));
        const LanePlaces place = placesAt(setup.samples, samples, SampleUse::pixel_area, reversed);
        packet.x = corners.x + place.u;
        packet.y = corners.y + place.v;
        addSample(setup, samples, reversed, packet, bounce, sums);
    }
}

void renderBlock(const RenderSetup& setup, const PixelBlock& block, int first, int end,
                 const RenderSums& sums) {
    const TileCorners corners = tileCorners();
    RayPacket packet;
    RayPacket bounce;
    prepare(packet.rays.ray);
    prepare(bounce.rays.ray);
    bounce.x = 0.0F;
    bounce.y = 0.0F;
    TileSamples samples;
    TileSums tile;
    for (int y = block.y_begin; y < block.y_end; y += tile_size)
        for (int x = block.x_begin; x < block.x_end; x += tile_size) {
            const std::size_t at =
                std::size_t{lane_count} * (static_cast<std::size_t>(y / tile_size) *
                                               static_cast<std::size_t>(sums.tile_columns) +
                                           static_cast<std::size_t>(x / tile_size));
            for (int p = 0; p < RenderPlane::count; ++p)
                tile.plane[p] = load(sums.planes[p] + at);
            startTile(x, y, setup.samples.log2_length, samples);
            packet.active = (corners.x < static_cast<float>(block.x_end - x)) &
                            (corners.y < static_cast<float>(block.y_end - y));
            renderTile(setup,
                       {corners.x + static_cast<float>(x), corners.y + static_cast<float>(y)},
                       first, end, samples, packet, bounce, tile);
            for (int p = 0; p < RenderPlane::count; ++p)
                store(sums.planes[p] + at, tile.plane[p]);
        }
}

void skyColorsToward(const FrameSetup& frame, const float (&directions)[3][lane_count],
                     float (&colors)[3][lane_count]) {
    RayPacket packet;
    packet.x = 0.0F;
    packet.y = 0.0F;
    packet.direction = {load(directions[0]), load(directions[1]), load(directions[2])};
    const LaneColors sky = skyColors(frame, packet);
    store(colors[0], sky.r);
    store(colors[1], sky.g);
    store(colors[2], sky.b);
}

} // namespace

extern const RenderKernel QUARN_RENDER_KERNEL;
const RenderKernel QUARN_RENDER_KERNEL{QUARN_RENDER_KERNEL_NAME, renderBlock, filterRow,
                                       skyColorsToward};

} // namespace quarn
