#include "engine/render/LightFit.h"

#include "engine/render/SmallSystem.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Variances of features below this are not worth explaining light by.
constexpr double least_variance = 1e-4;
/// And of nearness this, as a share of the distance or of the scene, squared.
constexpr float least_nearness_step = 0.004F;

/// Keeps features that go together apart, as a share of their variances.
constexpr double ridge = 0.01;

/// What is left of the light's variance is never less.
constexpr double least_left = 1e-6;

/// In an order of its own, which lets products be taken four at a time.
float sumOfProducts(const float* a, const float* b) {
    float part[4];
    for (int i = 0; i < 4; ++i)
        part[i] =
            (a[i] * b[i] + a[i + 4] * b[i + 4]) + (a[i + 8] * b[i + 8] + a[i + 12] * b[i + 12]);
    return (part[0] + part[1]) + (part[2] + part[3]);
}

} // namespace

/// What the pixels of a tile show, means of their samples.
struct LightFit::TilePixels {
    float feature[feature_count][lane_count];
    float light[3][lane_count];
    float samples;
};

LightFit::LightFit(const RenderLayers& layers, float parallel_scene_size)
    : m_layers(layers), m_columns(layers.sums().tile_columns),
      m_rows((layers.height() + tile_size - 1) / tile_size),
      m_nearness_share(parallel_scene_size > 0.0F ? 0.0F : least_nearness_step),
      m_nearness_tolerance(least_nearness_step * parallel_scene_size + 1e-20F),
      m_moments(tileAt(0, m_rows)), m_fits(tileAt(0, m_rows)), m_means(tileAt(0, m_rows)) {}

std::size_t LightFit::tileAt(int column, int row) const {
    return static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
           static_cast<std::size_t>(column);
}

template <class Work> void LightFit::forTiles(const Work& work) const {
    tbb::parallel_for(0, m_rows, [&](int row) {
        for (int column = 0; column < m_columns; ++column)
            work(column, row);
    });
}

/// For the tile and the up to eight beside it.
template <class Work> void LightFit::forTilesAround(int column, int row, const Work& work) const {
    for (int y = std::max(row - 1, 0); y <= std::min(row + 1, m_rows - 1); ++y)
        for (int x = std::max(column - 1, 0); x <= std::min(column + 1, m_columns - 1); ++x)
            work(tileAt(x, y));
}

LightFit::TilePixels LightFit::pixelsOf(std::size_t tile, const LightSums& kind) const {
    constexpr int planes[feature_count] = {
        RenderPlane::normal_x, RenderPlane::normal_y, RenderPlane::normal_z, RenderPlane::albedo_r,
        RenderPlane::albedo_g, RenderPlane::albedo_b, RenderPlane::nearness, RenderPlane::cover};
    const RenderSums sums = m_layers.sums();
    const std::size_t at = lane_count * tile;
    TilePixels pixels;
    pixels.samples = sums.planes[RenderPlane::samples][at];
    const float scale = 1.0F / pixels.samples;
    const auto read = [&](int plane, float* to) {
        for (std::size_t lane = 0; lane < lane_count; ++lane)
            to[lane] = scale * sums.planes[plane][at + lane];
    };
    for (int i = 0; i < feature_count; ++i)
        read(planes[i], pixels.feature[i]);
    for (int c = 0; c < 3; ++c)
        read(kind.first + c, pixels.light[c]);
    return pixels;
}

LightFit::Moments LightFit::momentsOf(std::size_t tile, const LightSums& kind) const {
    const TilePixels pixels = pixelsOf(tile, kind);
    float weights[lane_count];
    std::fill_n(weights, lane_count, pixels.samples);
    Moments moments{};
    moments.weight = pixels.samples * lane_count;
    int product = 0;
    for (int i = 0; i < feature_count; ++i) {
        float weighted[lane_count];
        for (int lane = 0; lane < lane_count; ++lane)
            weighted[lane] = pixels.samples * pixels.feature[i][lane];
        moments.feature[i] = sumOfProducts(weights, pixels.feature[i]);
        for (int j = 0; j <= i; ++j)
            moments.feature_feature[product++] = sumOfProducts(weighted, pixels.feature[j]);
        for (int c = 0; c < 3; ++c)
            moments.feature_light[i][c] = sumOfProducts(weighted, pixels.light[c]);
    }
    for (int c = 0; c < 3; ++c) {
        moments.light[c] = sumOfProducts(weights, pixels.light[c]);
        moments.light_light += pixels.samples * sumOfProducts(pixels.light[c], pixels.light[c]);
    }
    return moments;
}

LightFit::Moments LightFit::momentsAround(int column, int row) const {
    constexpr std::size_t numbers = sizeof(Moments) / sizeof(float);
    Moments sum{};
    forTilesAround(column, row, [&](std::size_t tile) {
        const auto* const from = reinterpret_cast<const float*>(&m_moments[tile]);
        auto* const to = reinterpret_cast<float*>(&sum);
        for (std::size_t i = 0; i < numbers; ++i)
            to[i] += from[i];
    });
    return sum;
}

/// The best fit, by covariances of features and light.
LightFit::Fit LightFit::fitOf(const Moments& moments) const {
    const double share = 1.0 / double{moments.weight};
    double mean[feature_count];
    double light[3];
    for (int i = 0; i < feature_count; ++i)
        mean[i] = moments.feature[i] * share;
    for (int c = 0; c < 3; ++c)
        light[c] = moments.light[c] * share;
    const double near = m_nearness_share * mean[nearness_index] + m_nearness_tolerance;
    SmallSystem<feature_count> system;
    double covariance[feature_count][3];
    int product = 0;
    for (int i = 0; i < feature_count; ++i) {
        for (int j = 0; j <= i; ++j)
            system.matrix[i][j] = moments.feature_feature[product++] * share - mean[i] * mean[j];
        system.matrix[i][i] = (1.0 + ridge) * std::max(system.matrix[i][i], 0.0) +
                              (i == nearness_index ? near * near : least_variance);
        for (int c = 0; c < 3; ++c)
            system.right[i][c] = covariance[i][c] =
                moments.feature_light[i][c] * share - mean[i] * light[c];
    }
    system.solve();
    Fit fit;
    double left = moments.light_light * share;
    for (int c = 0; c < 3; ++c) {
        double constant = light[c];
        left -= light[c] * light[c];
        for (int i = 0; i < feature_count; ++i) {
            constant -= system.right[i][c] * mean[i];
            left -= system.right[i][c] * covariance[i][c];
            fit.slope[i][c] = static_cast<float>(system.right[i][c]);
        }
        fit.constant[c] = static_cast<float>(constant);
    }
    fit.trust = static_cast<float>(1.0 / (std::max(left, 0.0) + least_left));
    return fit;
}

/// The mean of the fits that took the tile in.
LightFit::Fit LightFit::meanFitAround(int column, int row) const {
    Fit mean{};
    forTilesAround(column, row, [&](std::size_t tile) {
        const Fit& fit = m_fits[tile];
        mean.trust += fit.trust;
        for (int c = 0; c < 3; ++c) {
            mean.constant[c] += fit.trust * fit.constant[c];
            for (int i = 0; i < feature_count; ++i)
                mean.slope[i][c] += fit.trust * fit.slope[i][c];
        }
    });
    for (int c = 0; c < 3; ++c) {
        mean.constant[c] /= mean.trust;
        for (auto& slope : mean.slope)
            slope[c] /= mean.trust;
    }
    return mean;
}

/// How a pixel's light follows from its features: between the fits of its tile and of those on the
/// pixel's sides of it, so that no tile shows where the light changes alone.
class LightFit::FitBetween {
public:
    FitBetween(const LightFit& owner, int column, int row, int lane) {
        const Side across = sideOf(column, lane % tile_size, owner.m_columns);
        const Side down = sideOf(row, lane / tile_size, owner.m_rows);
        const auto part = [&](int place, int tile_column, int tile_row, float weight) {
            m_fits[place] = &owner.m_means[owner.tileAt(tile_column, tile_row)];
            m_weights[place] = weight;
        };
        part(0, column, row, (1.0F - across.weight) * (1.0F - down.weight));
        part(1, across.tile, row, across.weight * (1.0F - down.weight));
        part(2, column, down.tile, (1.0F - across.weight) * down.weight);
        part(3, across.tile, down.tile, across.weight * down.weight);
    }

    float light(int channel, const float* features) const {
        float sum = 0.0F;
        for (int place = 0; place < 4; ++place) {
            float light = m_fits[place]->constant[channel];
            for (int i = 0; i < feature_count; ++i)
                light += m_fits[place]->slope[i][channel] * features[i];
            sum += m_weights[place] * light;
        }
        return sum;
    }

private:
    struct Side {
        int tile;
        float weight;
    };

    static Side sideOf(int tile, int pixel, int count) {
        const float off = (static_cast<float>(pixel) + 0.5F) / tile_size - 0.5F;
        return {std::clamp(off < 0.0F ? tile - 1 : tile + 1, 0, count - 1), std::abs(off)};
    }

    const Fit* m_fits[4];
    float m_weights[4];
};

void LightFit::show(const LightSums& kind, int column, int row, PixelPlane (&fitted)[3]) const {
    const TilePixels pixels = pixelsOf(tileAt(column, row), kind);
    for (int lane = 0; lane < lane_count; ++lane) {
        const int x = tile_size * column + lane % tile_size;
        const int y = tile_size * row + lane / tile_size;
        if (x >= m_layers.width() || y >= m_layers.height())
            continue;
        const FitBetween fit(*this, column, row, lane);
        float features[feature_count];
        for (int i = 0; i < feature_count; ++i)
            features[i] = pixels.feature[i][lane];
        float sum[3];
        float albedo[3];
        float light[3];
        for (int c = 0; c < 3; ++c) {
            sum[c] = std::max(fit.light(c, features), 0.0F);
            albedo[c] = features[kind.times_albedo ? 3 + c : feature_count - 1];
        }
        withoutAlbedo(sum, albedo, light);
        for (int c = 0; c < 3; ++c)
            fitted[c].row(y)[x] = light[c];
    }
}

void LightFit::fit(const LightSums& kind, PixelPlane (&fitted)[3]) {
    forTiles([&](int column, int row) {
        const std::size_t tile = tileAt(column, row);
        m_moments[tile] = momentsOf(tile, kind);
    });
    forTiles([&](int column, int row) {
        m_fits[tileAt(column, row)] = fitOf(momentsAround(column, row));
    });
    forTiles(
        [&](int column, int row) { m_means[tileAt(column, row)] = meanFitAround(column, row); });
    forTiles([&](int column, int row) { show(kind, column, row, fitted); });
}

} // namespace quarn
