#pragma once

#include "engine/render/kernel/RenderSetup.h"

#include <cstddef>

namespace quarn {
namespace {

// Plain loops over a row: the compiler makes vectors of them, as wide as the processor's.

/// Where the pixels of a tap lie: those at x + offset of the row at `other`, for x in [begin, end).
struct Tap {
    std::ptrdiff_t center; ///< of the row's pixel 0
    std::ptrdiff_t other;  ///< of the pixel that is looked at from there
    float weight;
    float dx;
    float dy;
};

inline float brightnessOf(float r, float g, float b) {
    return 0.2126F * r + 0.7152F * g + 0.0722F * b;
}
inline float largerOf(float a, float b) {
    return a > b ? a : b;
}
inline float sizeOf(float a) {
    return a < 0.0F ? -a : a;
}

/// How much the pixel at `q` tells of the one at `p`: they must lie on one flat surface or a nearly
/// flat one, and be no more different than their noise explains.
inline float likeness(const FilterRow& row, std::ptrdiff_t p, std::ptrdiff_t q, const Tap& tap) {
    const float turn = row.normal[0][p] * row.normal[0][q] + row.normal[1][p] * row.normal[1][q] +
                       row.normal[2][p] * row.normal[2][q];
    const float along = largerOf(turn, 0.0F);
    const float along2 = along * along;
    const float along4 = along2 * along2;
    const float along16 = along4 * along4 * along4 * along4;
    const float expected = row.nearness[p] + tap.dx * row.slope_x[p] + tap.dy * row.slope_y[p];
    const float off = sizeOf(row.nearness[q] - expected);
    const float allowed = row.nearness_share * row.nearness[p] + row.nearness_tolerance +
                          0.25F * (sizeOf(row.slope_x[p]) + sizeOf(row.slope_y[p]));
    const float same_plane = largerOf(0.0F, 1.0F - off / allowed);
    const float step =
        brightnessOf(row.light[0][q] - row.light[0][p], row.light[1][q] - row.light[1][p],
                     row.light[2][q] - row.light[2][p]);
    const float noise = row.spread * (row.variance[p] + row.variance[q]) + 1e-9F;
    const float alike = largerOf(0.0F, 1.0F - step * step / noise);
    return along16 * along16 * same_plane * alike * alike * row.cover[q];
}

inline void addTap(const FilterRow& row, const Tap& tap, int begin, int end) {
    float* const __restrict weight = row.weight + tap.center;
    float* const __restrict r = row.out[0] + tap.center;
    float* const __restrict g = row.out[1] + tap.center;
    float* const __restrict b = row.out[2] + tap.center;
    float* const __restrict variance = row.out_variance + tap.center;
    for (std::ptrdiff_t x = begin; x < end; ++x) {
        const std::ptrdiff_t q = tap.other + x;
        const float w = tap.weight * likeness(row, tap.center + x, q, tap);
        weight[x] += w;
        r[x] += w * row.light[0][q];
        g[x] += w * row.light[1][q];
        b[x] += w * row.light[2][q];
        variance[x] += w * w * row.variance[q];
    }
}

/// The pixel itself counts in full.
inline void startRow(const FilterRow& row, std::ptrdiff_t start, float own_weight) {
    for (std::ptrdiff_t p = start; p < start + row.width; ++p) {
        row.weight[p] = own_weight;
        for (int c = 0; c < 3; ++c)
            row.out[c][p] = own_weight * row.light[c][p];
        row.out_variance[p] = own_weight * own_weight * row.variance[p];
    }
}

inline void endRow(const FilterRow& row, std::ptrdiff_t start) {
    for (std::ptrdiff_t p = start; p < start + row.width; ++p) {
        const float scale = 1.0F / row.weight[p];
        for (int c = 0; c < 3; ++c)
            row.out[c][p] *= scale;
        row.out_variance[p] *= scale * scale;
    }
}

/// One row of one pass of the edge-avoiding a-trous wavelet filter (H. Dammertz, D. Sewtz,
/// J. Hanika and H. Lensch, "Edge-Avoiding A-Trous Wavelet Transform for fast Global Illumination
/// Filtering", High Performance Graphics 2010), steered by the variance as in C. Schied et al.,
/// "Spatiotemporal Variance-Guided Filtering", High Performance Graphics 2017.
void filterRow(const FilterRow& row) {
    constexpr float spline[5] = {1.0F / 16, 1.0F / 4, 3.0F / 8, 1.0F / 4, 1.0F / 16};
    const std::ptrdiff_t start = static_cast<std::ptrdiff_t>(row.y) * row.width;
    startRow(row, start, spline[2] * spline[2]);
    for (int j = -2; j <= 2; ++j) {
        const int dy = j * row.step;
        if (row.y + dy < 0 || row.y + dy >= row.height)
            continue;
        for (int i = -2; i <= 2; ++i) {
            const int dx = i * row.step;
            if (i == 0 && j == 0)
                continue;
            const Tap tap{start, start + static_cast<std::ptrdiff_t>(dy) * row.width + dx,
                          spline[i + 2] * spline[j + 2], static_cast<float>(dx),
                          static_cast<float>(dy)};
            addTap(row, tap, dx < 0 ? -dx : 0, dx > 0 ? row.width - dx : row.width);
        }
    }
    endRow(row, start);
}

} // namespace
} // namespace quarn
