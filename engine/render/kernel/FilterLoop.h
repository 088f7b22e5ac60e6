#pragma once

#include "engine/display/kernel/Lanes.h"
#include "engine/render/kernel/RenderSetup.h"

#include <cstddef>

namespace quarn {
namespace {

/// Sixteen numbers that begin anywhere.
inline Lanes loadAnywhere(const float* from) {
    const auto* const words = reinterpret_cast<const std::uint32_t*>(from);
    return eachPart<Lanes>([&](int p) {
        return reinterpret_cast<NativeFloats>(nativeLoad(words + p * native_lanes));
    });
}

/// The surfaces that sixteen pixels show.
struct GuideLanes {
    LaneVectors normal;
    Lanes nearness;
    Lanes slope_x;
    Lanes slope_y;
    Lanes tolerance;
};

inline GuideLanes guidesAt(const FilterGuides& guides, std::ptrdiff_t x) {
    return {{load(guides.normal[0] + x), load(guides.normal[1] + x), load(guides.normal[2] + x)},
            load(guides.nearness + x),
            load(guides.slope_x + x),
            load(guides.slope_y + x),
            load(guides.tolerance + x)};
}

/// Where the pixels that are looked at lie, seen from those that they are for.
struct Tap {
    std::ptrdiff_t offset;
    float weight;
    float dx;
    float dy;
};

/// How surely the pixels from `q` on show the same surface: one flat surface or a nearly flat one.
inline Lanes sameSurface(const FilterGuides& guides, const GuideLanes& own, std::ptrdiff_t q,
                         const Tap& tap) {
    const Lanes turn = own.normal.x * loadAnywhere(guides.normal[0] + q) +
                       own.normal.y * loadAnywhere(guides.normal[1] + q) +
                       own.normal.z * loadAnywhere(guides.normal[2] + q);
    const Lanes along = greatest(turn, 0.0F);
    const Lanes along2 = along * along;
    const Lanes along4 = along2 * along2;
    const Lanes along16 = along4 * along4 * (along4 * along4);
    const Lanes expected = own.nearness + own.slope_x * tap.dx + own.slope_y * tap.dy;
    const Lanes off = magnitude(loadAnywhere(guides.nearness + q) - expected);
    const Lanes same_plane = greatest(Lanes(1.0F) - off * own.tolerance, 0.0F);
    return along16 * along16 * same_plane;
}

/// Light of sixteen pixels, or sums of it.
struct LightLanes {
    LaneColors color;
    Lanes variance;
    Lanes weight;
};

inline Lanes brightnessOf(const LaneColors& c) {
    return c.r * 0.2126F + c.g * 0.7152F + c.b * 0.0722F;
}

/// Adds what the pixels from `q` on tell of the light, all the more the less it differs beyond
/// what noise explains.
/// @param surface  how much they tell by what they show
inline void addTap(const FilterLight& light, const LightLanes& own, std::ptrdiff_t q,
                   const Lanes& surface, LightLanes& sum) {
    const LaneColors color{loadAnywhere(light.color[0] + q), loadAnywhere(light.color[1] + q),
                           loadAnywhere(light.color[2] + q)};
    const Lanes variance = loadAnywhere(light.variance + q);
    const Lanes step = brightnessOf(color - own.color);
    const Lanes noise = (own.variance + variance) * light.spread + 1e-9F;
    const Lanes alike = greatest(Lanes(1.0F) - step * step / noise, 0.0F);
    const Lanes weight = surface * alike * alike;
    sum.color = sum.color + color * weight;
    sum.variance = sum.variance + variance * (weight * weight);
    sum.weight = sum.weight + weight;
}

template <int light_count> void filterSixteen(const FilterRow& row, std::ptrdiff_t x) {
    constexpr float spline[5] = {1.0F / 16, 1.0F / 4, 3.0F / 8, 1.0F / 4, 1.0F / 16};
    constexpr float own_weight = spline[2] * spline[2]; // the pixel itself counts in full
    const GuideLanes guides = guidesAt(row.guides, x);
    LightLanes own[light_count];
    LightLanes sum[light_count];
    for (int k = 0; k < light_count; ++k) {
        const FilterLight& light = row.lights[k];
        own[k] = {{load(light.color[0] + x), load(light.color[1] + x), load(light.color[2] + x)},
                  load(light.variance + x),
                  own_weight};
        sum[k] = {own[k].color * Lanes(own_weight), own[k].variance * (own_weight * own_weight),
                  own_weight};
    }
    for (int j = -2; j <= 2; ++j) {
        const int dy = j * row.step;
        if (row.y + dy < 0 || row.y + dy >= row.height)
            continue;
        for (int i = -2; i <= 2; ++i) {
            if (i == 0 && j == 0)
                continue;
            const int dx = i * row.step;
            const Tap tap{dy * row.stride + dx, spline[i + 2] * spline[j + 2],
                          static_cast<float>(dx), static_cast<float>(dy)};
            const Lanes any = loadAnywhere(row.guides.cover + x + tap.offset) * tap.weight;
            const Lanes same = any * sameSurface(row.guides, guides, x + tap.offset, tap);
            for (int k = 0; k < light_count; ++k)
                addTap(row.lights[k], own[k], x + tap.offset,
                       row.lights[k].across_surfaces ? any : same, sum[k]);
        }
    }
    for (int k = 0; k < light_count; ++k) {
        const Lanes scale = Lanes(1.0F) / sum[k].weight;
        store(row.lights[k].out[0] + x, sum[k].color.r * scale);
        store(row.lights[k].out[1] + x, sum[k].color.g * scale);
        store(row.lights[k].out[2] + x, sum[k].color.b * scale);
        store(row.lights[k].out_variance + x, sum[k].variance * (scale * scale));
    }
}

/// One row of one pass of the edge-avoiding a-trous wavelet filter (H. Dammertz, D. Sewtz,
/// J. Hanika and H. Lensch, "Edge-Avoiding A-Trous Wavelet Transform for fast Global Illumination
/// Filtering", High Performance Graphics 2010), steered by the variance as in C. Schied et al.,
/// "Spatiotemporal Variance-Guided Filtering", High Performance Graphics 2017.
void filterRow(const FilterRow& row) {
    for (std::ptrdiff_t x = 0; x < row.width; x += lane_count) {
        if (row.light_count == 2)
            filterSixteen<2>(row, x);
        else
            filterSixteen<1>(row, x);
    }
}

} // namespace
} // namespace quarn
