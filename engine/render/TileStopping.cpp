#include "engine/render/TileStopping.h"

#include "engine/display/DisplayTable.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <bit>
#include <cmath>

namespace quarn {

namespace {

/// Steps of 255 that a picture of one sample may be wrong by; of more samples less, as noise is.
constexpr float tolerance_of_one = 4.0F;

/// Parts of the noise that the filter leaves on one flat surface: of light from all around, and of
/// the suns', whose borders it keeps.
constexpr float left_of_sky = 0.2F;
constexpr float left_of_sun = 0.6F;

/// How much more it leaves where surfaces meet.
constexpr float left_by_mixture = 8.0F;

/// A tile's own error may have been missed by chance: that of a neighbour counts half.
constexpr float share_of_neighbours = 0.5F;

/// The brightness of a sum of colours.
struct HalvedSum {
    float mean;
    float error; ///< half the difference of the halves' means
};

class TilePixel {
public:
    TilePixel(const RenderSums& sums, std::size_t at) : m_sums(sums), m_at(at) {
        const float samples = value(RenderPlane::samples);
        m_even = std::ceil(0.5F * samples);
        m_odd = samples - m_even;
    }

    float value(int plane) const { return m_sums.planes[plane][m_at]; }

    HalvedSum halved(int first, int even_plane) const {
        const float all =
            0.2126F * value(first) + 0.7152F * value(first + 1) + 0.0722F * value(first + 2);
        const float even = value(even_plane);
        return {all / (m_even + m_odd), 0.5F * (even / m_even - (all - even) / m_odd)};
    }

    /// 1 on one flat surface, less where surfaces meet.
    float purity() const {
        const float cover = value(RenderPlane::cover);
        const float x = value(RenderPlane::normal_x);
        const float y = value(RenderPlane::normal_y);
        const float z = value(RenderPlane::normal_z);
        return cover > 0.0F ? std::sqrt(x * x + y * y + z * z) / cover : 1.0F;
    }

private:
    const RenderSums& m_sums;
    std::size_t m_at;
    float m_even;
    float m_odd;
};

int placeOf(float light) {
    const auto place = static_cast<int>(std::bit_cast<std::uint32_t>(std::max(light, 0.0F)) >>
                                        DisplayTable::shift) -
                       DisplayTable::first;
    return std::clamp(place, 0, DisplayTable::count - 1);
}

/// Steps of 255 per unit of light.
float steepness(float light) {
    const std::uint32_t* const table = displayTable().entries();
    const float around = std::max(light, 4.0F * DisplayTable::darkest);
    const float low = 0.85F * around;
    const float high = 1.15F * around;
    const auto steps =
        static_cast<float>(table[placeOf(high)]) - static_cast<float>(table[placeOf(low)]);
    return steps / (high - low);
}

/// Squared, in steps of 255.
float errorOfPixel(const TilePixel& pixel) {
    const HalvedSum direct = pixel.halved(RenderPlane::direct_r, RenderPlane::even_direct);
    const HalvedSum albedo = pixel.halved(RenderPlane::albedo_r, RenderPlane::even_albedo);
    const HalvedSum sky = pixel.halved(RenderPlane::sky_r, RenderPlane::even_sky);
    const HalvedSum sun = pixel.halved(RenderPlane::sun_r, RenderPlane::even_sun);
    const HalvedSum gloss = pixel.halved(RenderPlane::gloss_r, RenderPlane::even_gloss);
    const float per_albedo = albedo.mean > 0.0F ? 1.0F / albedo.mean : 0.0F;
    const float of_albedo = albedo.error * per_albedo;
    const float mixed = left_by_mixture * (1.0F - std::min(pixel.purity(), 1.0F));
    const float of_sky = std::min(left_of_sky + mixed, 1.0F) * (sky.error - of_albedo * sky.mean);
    const float of_sun = std::min(left_of_sun + mixed, 1.0F) * (sun.error - of_albedo * sun.mean);
    const float sharp = direct.error + gloss.error + of_albedo * (sky.mean + sun.mean);
    const float error =
        (sharp + of_sun + of_sky) * steepness(direct.mean + sky.mean + sun.mean + gloss.mean);
    return error * error;
}

} // namespace

TileStopping::TileStopping(RenderLayers& layers, int samples)
    : m_layers(layers), m_columns(layers.sums().tile_columns),
      m_rows((layers.height() + tile_size - 1) / tile_size),
      m_tolerance(tolerance_of_one * tolerance_of_one / static_cast<float>(samples)),
      m_errors(layers.done().size()) {}

float TileStopping::errorOf(std::size_t tile) const {
    const RenderSums sums = m_layers.sums();
    float sum = 0.0F;
    for (std::size_t lane = 0; lane < lane_count; ++lane)
        sum += errorOfPixel(TilePixel(sums, lane_count * tile + lane));
    return sum / lane_count;
}

std::size_t TileStopping::tileAt(int column, int row) const {
    return static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
           static_cast<std::size_t>(column);
}

float TileStopping::errorAround(int column, int row) const {
    float worst = 0.0F;
    for (int y = std::max(row - 1, 0); y <= std::min(row + 1, m_rows - 1); ++y)
        for (int x = std::max(column - 1, 0); x <= std::min(column + 1, m_columns - 1); ++x) {
            const float error = m_errors[tileAt(x, y)];
            worst = std::max(worst, y == row && x == column ? error : share_of_neighbours * error);
        }
    return worst;
}

bool TileStopping::stopGoodTiles() {
    std::vector<std::uint8_t>& done = m_layers.done();
    tbb::parallel_for(0, m_rows, [&](int row) {
        for (std::size_t tile = tileAt(0, row); tile < tileAt(0, row + 1); ++tile)
            if (!done[tile])
                m_errors[tile] = errorOf(tile);
    });
    tbb::parallel_for(0, m_rows, [&](int row) {
        for (int column = 0; column < m_columns; ++column)
            if (errorAround(column, row) <= m_tolerance)
                done[tileAt(column, row)] = 1;
    });
    return std::find(done.begin(), done.end(), 0) != done.end();
}

} // namespace quarn
