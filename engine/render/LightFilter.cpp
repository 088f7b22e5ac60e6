#include "engine/render/LightFilter.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>
#include <utility>

namespace quarn {

namespace {

/// How far nearness may deviate from a plane, as a share of the distance or of the scene.
constexpr float plane_tolerance = 0.004F;

/// Below this albedo a channel tells nothing of the light.
constexpr float least_albedo = 0.02F;

/// The variance of a few samples says little; then it is taken to be as large as the light.
constexpr int few_samples = 4;

/// From so many on a pixel's own variance is sure enough.
constexpr int many_samples = 32;

/// Differences of up to so many standard deviations, squared, are taken for noise.
constexpr float noise_spread = 9.0F;

std::size_t pixelCount(const RenderLayers& layers) {
    return static_cast<std::size_t>(layers.width()) * static_cast<std::size_t>(layers.height());
}

/// For all pixels, row by row: work(pixel, x, y).
template <class Work> void forPixels(const RenderLayers& layers, const Work& work) {
    tbb::parallel_for(0, layers.height(), [&](int y) {
        const std::size_t start =
            static_cast<std::size_t>(y) * static_cast<std::size_t>(layers.width());
        for (int x = 0; x < layers.width(); ++x)
            work(start + static_cast<std::size_t>(x), x, y);
    });
}

/// The smaller step of the two to either side, so that an edge on one side does not count.
float slope(const std::vector<float>& plane, std::size_t at, std::size_t stride, bool has_before,
            bool has_behind) {
    const float before = has_before ? plane[at] - plane[at - stride] : INFINITY;
    const float behind = has_behind ? plane[at + stride] - plane[at] : INFINITY;
    const float least = std::fabs(before) < std::fabs(behind) ? before : behind;
    return std::isfinite(least) ? least : 0.0F;
}

/// Light of a pixel without albedo. A channel in which the surface is black takes the light of the
/// channel in which it is brightest.
void withoutAlbedo(const float (&sum)[3], const float (&albedo)[3], float (&light)[3]) {
    const auto brightest = std::max_element(albedo, albedo + 3) - albedo;
    const float sure = albedo[brightest] > 0.0F ? sum[brightest] / albedo[brightest] : 0.0F;
    for (int c = 0; c < 3; ++c)
        light[c] = albedo[c] > least_albedo * albedo[brightest] ? sum[c] / albedo[c] : sure;
}

} // namespace

LightFilter::LightFilter(const RenderLayers& layers, float parallel_scene_size,
                         const RenderKernel& kernel)
    : m_layers(layers), m_kernel(kernel),
      m_nearness_share(parallel_scene_size > 0.0F ? 0.0F : plane_tolerance),
      m_nearness_tolerance(plane_tolerance * parallel_scene_size + 1e-20F) {
    const std::size_t count = pixelCount(layers);
    for (auto& plane : m_normal)
        plane.resize(count);
    for (auto& plane : m_slope)
        plane.resize(count);
    for (LightImage* image : {&m_light, &m_other}) {
        for (auto& plane : image->color)
            plane.resize(count);
        image->variance.resize(count);
    }
    for (auto* plane : {&m_nearness, &m_cover, &m_weight})
        plane->resize(count);
    readGuides();
    readSlopes();
}

void LightFilter::readGuides() {
    forPixels(m_layers, [&](std::size_t pixel, int x, int y) {
        const float cover = m_layers.at(RenderPlane::cover, x, y);
        float normal[3];
        float square = 0.0F;
        for (int axis = 0; axis < 3; ++axis) {
            normal[axis] = m_layers.at(RenderPlane::normal_x + axis, x, y);
            square += normal[axis] * normal[axis];
        }
        const float scale = square > 0.0F ? 1.0F / std::sqrt(square) : 0.0F;
        for (int axis = 0; axis < 3; ++axis)
            m_normal[axis][pixel] = normal[axis] * scale;
        m_nearness[pixel] = cover > 0.0F ? m_layers.at(RenderPlane::nearness, x, y) / cover : 0.0F;
        m_cover[pixel] = cover / m_layers.at(RenderPlane::samples, x, y);
    });
}

void LightFilter::readSlopes() {
    const auto stride = static_cast<std::size_t>(m_layers.width());
    forPixels(m_layers, [&](std::size_t pixel, int x, int y) {
        m_slope[0][pixel] = slope(m_nearness, pixel, 1, x > 0, x + 1 < m_layers.width());
        m_slope[1][pixel] = slope(m_nearness, pixel, stride, y > 0, y + 1 < m_layers.height());
    });
}

void LightFilter::readLight(int first, int square) {
    forPixels(m_layers, [&](std::size_t pixel, int x, int y) {
        const int samples = m_layers.samplesAt(x, y);
        float sum[3];
        float albedo[3];
        float light[3];
        for (int c = 0; c < 3; ++c) {
            sum[c] = m_layers.at(first + c, x, y);
            albedo[c] = m_layers.at(RenderPlane::albedo_r + c, x, y);
        }
        withoutAlbedo(sum, albedo, light);
        for (int c = 0; c < 3; ++c)
            m_light.color[c][pixel] = light[c];
        const float cover = m_layers.at(RenderPlane::cover, x, y);
        const float brightness = 0.2126F * light[0] + 0.7152F * light[1] + 0.0722F * light[2];
        const float mean_square = cover > 0.0F ? m_layers.at(square, x, y) / cover : 0.0F;
        const float spread = samples < few_samples
                                 ? mean_square
                                 : std::max(0.0F, mean_square - brightness * brightness);
        m_other.variance[pixel] = spread / static_cast<float>(samples);
    });
}

/// Neighbours know better than a pixel alone how far its samples scatter, all the more the fewer
/// these are.
void LightFilter::smoothVariance() {
    const auto stride = static_cast<std::ptrdiff_t>(m_layers.width());
    forPixels(m_layers, [&](std::size_t pixel, int x, int y) {
        const int reach = m_layers.samplesAt(x, y) < many_samples ? 3 : 1;
        float sum = 0.0F;
        float weights = 0.0F;
        for (int dy = -std::min(reach, y); dy <= std::min(reach, m_layers.height() - 1 - y); ++dy)
            for (int dx = -std::min(reach, x); dx <= std::min(reach, m_layers.width() - 1 - x);
                 ++dx) {
                const auto at = static_cast<std::ptrdiff_t>(pixel) + dy * stride + dx;
                const auto other = static_cast<std::size_t>(at);
                const float weight =
                    static_cast<float>((reach + 1 - std::abs(dx)) * (reach + 1 - std::abs(dy))) *
                    m_cover[other];
                sum += weight * m_other.variance[other];
                weights += weight;
            }
        m_light.variance[pixel] = weights > 0.0F ? sum / weights : 0.0F;
    });
}

void LightFilter::pass(int step) {
    tbb::parallel_for(0, m_layers.height(), [&](int y) {
        FilterRow row;
        row.width = m_layers.width();
        row.height = m_layers.height();
        row.y = y;
        row.step = step;
        for (int c = 0; c < 3; ++c) {
            row.light[c] = m_light.color[c].data();
            row.normal[c] = m_normal[c].data();
            row.out[c] = m_other.color[c].data();
        }
        row.variance = m_light.variance.data();
        row.out_variance = m_other.variance.data();
        row.nearness = m_nearness.data();
        row.slope_x = m_slope[0].data();
        row.slope_y = m_slope[1].data();
        row.cover = m_cover.data();
        row.nearness_share = m_nearness_share;
        row.nearness_tolerance = m_nearness_tolerance;
        row.spread = noise_spread;
        row.weight = m_weight.data();
        m_kernel.filter_row(row);
    });
    std::swap(m_light, m_other);
}

const LightImage& LightFilter::filtered(int first, int square) {
    readLight(first, square);
    smoothVariance();
    for (const int step : {1, 2, 4, 8})
        pass(step);
    return m_light;
}

} // namespace quarn
