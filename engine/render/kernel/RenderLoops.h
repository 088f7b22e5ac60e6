// The render loops. Each RenderKernel_*.cpp includes this once, with its own processor's flags.

#include "engine/render/kernel/FilterLoop.h"
#include "engine/render/kernel/Samples.h"

namespace quarn {
namespace {

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
        const auto places = [&](SampleUse use) {
            return placesAt(setup.samples, samples, use, reversed);
        };
        const LanePlaces place = places(SampleUse::pixel_area);
        packet.x = corners.x + place.u;
        packet.y = corners.y + place.v;
        SampleRays rays{setup, places(SampleUse::sky_dome), places(SampleUse::sun_disc), packet,
                        bounce};
        addSample(rays, sums);
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
    setDirection(packet.rays.ray, {load(directions[0]), load(directions[1]), load(directions[2])});
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
