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

/// The sums whose brightness is also known of every second sample alone.
constexpr int halved_count = 5;
constexpr struct {
    int sum;
    int even;
} halved_planes[halved_count] = {{RenderPlane::direct_r, RenderPlane::even_direct},
                                 {RenderPlane::albedo_r, RenderPlane::even_albedo},
                                 {RenderPlane::sky_r, RenderPlane::even_sky},
                                 {RenderPlane::sun_r, RenderPlane::even_sun},
                                 {RenderPlane::gloss_r, RenderPlane::even_gloss}};

inline void readBrightness(const TileSums& sums, Lanes (&brightness)[halved_count]) {
    for (int i = 0; i < halved_count; ++i) {
        const Lanes* const plane = sums.plane + halved_planes[i].sum;
        brightness[i] = luminance({plane[0], plane[1], plane[2]});
    }
}

/// Adds a sample with an even number, and what it adds to the halves.
inline void addEvenSample(const RenderSetup& setup, const SampleNumber& sample, RayPacket& packet,
                          TileSums& sums) {
    Lanes before[halved_count];
    Lanes behind[halved_count];
    readBrightness(sums, before);
    addSample(setup, sample, packet, sums);
    readBrightness(sums, behind);
    for (int i = 0; i < halved_count; ++i)
        sums.add(halved_planes[i].even, behind[i] - before[i]);
}

inline void renderTile(const RenderSetup& setup, const TileCorners& corners, int first, int end,
                       const TileSamples& samples, RayPacket& packet, TileSums& sums) {
    for (int index = first; index < end; ++index) {
        const SampleNumber sample{setup.samples, samples,
                                  reversedBits(static_cast<std::uint32_t>(index))};
        const LanePlaces place = placesAt(sample, SampleUse::pixel_area, 0);
        packet.x = corners.x + place.u;
        packet.y = corners.y + place.v;
        if (index % 2 == 0)
            addEvenSample(setup, sample, packet, sums);
        else
            addSample(setup, sample, packet, sums);
    }
    sums.add(RenderPlane::samples, static_cast<float>(end - first));
}

void renderBlock(const RenderSetup& setup, const PixelBlock& block, int first, int end,
                 const RenderSums& sums) {
    const TileCorners corners = tileCorners();
    RayPacket packet;
    prepare(packet.rays.ray);
    TileSamples samples;
    TileSums tile;
    for (int y = block.y_begin; y < block.y_end; y += tile_size)
        for (int x = block.x_begin; x < block.x_end; x += tile_size) {
            const std::size_t index = static_cast<std::size_t>(y / tile_size) *
                                          static_cast<std::size_t>(sums.tile_columns) +
                                      static_cast<std::size_t>(x / tile_size);
            if (sums.done && sums.done[index])
                continue;
            const std::size_t at = lane_count * index;
            for (int p = 0; p < RenderPlane::count; ++p)
                tile.plane[p] = load(sums.planes[p] + at);
            startTile(x, y, setup.samples.log2_length, samples);
            packet.active = (corners.x < static_cast<float>(block.x_end - x)) &
                            (corners.y < static_cast<float>(block.y_end - y));
            renderTile(setup,
                       {corners.x + static_cast<float>(x), corners.y + static_cast<float>(y)},
                       first, end, samples, packet, tile);
            for (int p = 0; p < RenderPlane::count; ++p)
                store(sums.planes[p] + at, tile.plane[p]);
        }
}

void lightFromAround(const FrameSetup& frame, const float (&directions)[3][lane_count],
                     float (&colors)[3][lane_count]) {
    const LaneColors light =
        lightAround(frame, {load(directions[0]), load(directions[1]), load(directions[2])});
    store(colors[0], light.r);
    store(colors[1], light.g);
    store(colors[2], light.b);
}

} // namespace

extern const RenderKernel QUARN_RENDER_KERNEL;
const RenderKernel QUARN_RENDER_KERNEL{QUARN_RENDER_KERNEL_NAME, renderBlock, filterRow,
                                       lightFromAround};

} // namespace quarn
