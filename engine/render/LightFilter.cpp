#include "engine/render/LightFilter.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>
#include <utility>

namespace quarn {

namespace {

/// How far nearness may deviate from a plane, as a share of the distance or of the scene.
constexpr float plane_tolerance = 0.004F;

/// The variance of a few samples says little; then it is taken to be as large as the light.
constexpr int few_samples = 4;

/// A pixel whose samples scatter more than those around it counts so much of that at least: else
/// one that met something bright by chance would stay as it is, a lone dot.
constexpr float own_part = 0.6F;

/// From so many on a pixel's own variance is sure enough.
constexpr int many_samples = 32;

template <class Work> void forEachRow(const RenderLayers& layers, const Work& work) {
    tbb::parallel_for(0, layers.height(), [&](int y) { work(y); });
}

/// The smaller step of the two to either side, so that an edge on one side does not count.
float slope(float before, float own, float behind) {
    const float step =
        std::fabs(own - before) < std::fabs(behind - own) ? own - before : behind - own;
    return std::isfinite(step) ? step : 0.0F;
}

} // namespace

LightImage::LightImage(int width, int height) : variance(width, height) {
    for (PixelPlane& plane : color)
        plane = PixelPlane(width, height);
}

LightFilter::LightFilter(const RenderLayers& layers, float parallel_scene_size,
                         const RenderKernel& kernel)
    : m_layers(layers), m_kernel(kernel),
      m_fit(layers, parallel_scene_size), m_lights{{layers.width(), layers.height()},
                                                   {layers.width(), layers.height()}},
      m_others{{layers.width(), layers.height()}, {layers.width(), layers.height()}},
      m_nearness_share(parallel_scene_size > 0.0F ? 0.0F : plane_tolerance),
      m_nearness_tolerance(plane_tolerance * parallel_scene_size + 1e-20F) {
    for (PixelPlane* plane :
         {&m_fitted[0], &m_fitted[1], &m_fitted[2], &m_normal[0], &m_normal[1], &m_normal[2],
          &m_nearness, &m_slope[0], &m_slope[1], &m_tolerance, &m_cover})
        *plane = PixelPlane(layers.width(), layers.height());
    readGuides();
    readSlopes();
}

void LightFilter::readGuides() {
    forEachRow(m_layers, [&](int y) {
        for (int x = 0; x < m_layers.width(); ++x) {
            const float cover = m_layers.at(RenderPlane::cover, x, y);
            float normal[3];
            float square = 0.0F;
            for (int axis = 0; axis < 3; ++axis) {
                normal[axis] = m_layers.at(RenderPlane::normal_x + axis, x, y);
                square += normal[axis] * normal[axis];
            }
            const float scale = square > 0.0F ? 1.0F / std::sqrt(square) : 0.0F;
            for (int axis = 0; axis < 3; ++axis)
                m_normal[axis].row(y)[x] = normal[axis] * scale;
            m_nearness.row(y)[x] =
                cover > 0.0F ? m_layers.at(RenderPlane::nearness, x, y) / cover : 0.0F;
            m_cover.row(y)[x] = cover / m_layers.at(RenderPlane::samples, x, y);
        }
    });
}

void LightFilter::readSlopes() {
    const int last_x = m_layers.width() - 1;
    const int last_y = m_layers.height() - 1;
    forEachRow(m_layers, [&](int y) {
        const float* const near = m_nearness.row(y);
        const std::ptrdiff_t stride = m_nearness.stride();
        for (int x = 0; x <= last_x; ++x) {
            const float across =
                slope(x > 0 ? near[x - 1] : INFINITY, near[x], x < last_x ? near[x + 1] : INFINITY);
            const float down = slope(y > 0 ? near[x - stride] : INFINITY, near[x],
                                     y < last_y ? near[x + stride] : INFINITY);
            m_slope[0].row(y)[x] = across;
            m_slope[1].row(y)[x] = down;
            m_tolerance.row(y)[x] = 1.0F / (m_nearness_share * near[x] + m_nearness_tolerance +
                                            0.25F * (std::fabs(across) + std::fabs(down)));
        }
    });
}

void LightFilter::readLight(const LightSums& kind, LightImage& image, PixelPlane& variance) const {
    forEachRow(m_layers, [&](int y) {
        for (int x = 0; x < m_layers.width(); ++x) {
            const int samples = m_layers.samplesAt(x, y);
            const float cover = m_layers.at(RenderPlane::cover, x, y);
            float sum[3];
            float albedo[3];
            float light[3];
            for (int c = 0; c < 3; ++c) {
                sum[c] = m_layers.at(kind.first + c, x, y);
                albedo[c] =
                    kind.times_albedo ? m_layers.at(RenderPlane::albedo_r + c, x, y) : cover;
            }
            withoutAlbedo(sum, albedo, light);
            for (int c = 0; c < 3; ++c)
                image.color[c].row(y)[x] = light[c];
            const float brightness = 0.2126F * light[0] + 0.7152F * light[1] + 0.0722F * light[2];
            const float mean_square = cover > 0.0F ? m_layers.at(kind.square, x, y) / cover : 0.0F;
            const float spread = samples < few_samples
                                     ? mean_square
                                     : std::max(0.0F, mean_square - brightness * brightness);
            variance.row(y)[x] = spread / static_cast<float>(samples);
        }
    });
}

/// Neighbours know better than a pixel alone how far its samples scatter, all the more the fewer
/// these are.
void LightFilter::smoothVariance(const PixelPlane& from, PixelPlane& to) const {
    forEachRow(m_layers, [&](int y) {
        for (int x = 0; x < m_layers.width(); ++x) {
            const int reach = m_layers.samplesAt(x, y) < many_samples ? 3 : 1;
            float sum = 0.0F;
            float weights = 0.0F;
            for (int dy = -std::min(reach, y); dy <= std::min(reach, m_layers.height() - 1 - y);
                 ++dy)
                for (int dx = -reach; dx <= reach; ++dx) {
                    const float weight = static_cast<float>((reach + 1 - std::abs(dx)) *
                                                            (reach + 1 - std::abs(dy))) *
                                         m_cover.row(y + dy)[x + dx];
                    sum += weight * from.row(y + dy)[x + dx];
                    weights += weight;
                }
            const float around = weights > 0.0F ? sum / weights : 0.0F;
            to.row(y)[x] = std::max(around, own_part * from.row(y)[x]);
        }
    });
}

void LightFilter::pass(int step, std::span<const LightSums> kinds) {
    tbb::parallel_for(0, m_layers.height(), [&](int y) {
        FilterRow row;
        row.width = m_layers.width();
        row.height = m_layers.height();
        row.y = y;
        row.step = step;
        row.stride = m_cover.stride();
        for (int axis = 0; axis < 3; ++axis)
            row.guides.normal[axis] = m_normal[axis].row(y);
        row.guides.nearness = m_nearness.row(y);
        row.guides.slope_x = m_slope[0].row(y);
        row.guides.slope_y = m_slope[1].row(y);
        row.guides.tolerance = m_tolerance.row(y);
        row.guides.cover = m_cover.row(y);
        row.light_count = static_cast<int>(kinds.size());
        for (std::size_t k = 0; k < kinds.size(); ++k) {
            FilterLight& light = row.lights[k];
            for (int c = 0; c < 3; ++c) {
                light.color[c] = m_lights[k].color[c].row(y);
                light.out[c] = m_others[k].color[c].row(y);
            }
            light.variance = m_lights[k].variance.row(y);
            light.out_variance = m_others[k].variance.row(y);
            light.across_surfaces = kinds[k].follows_surfaces;
            light.spread = kinds[k].spread;
        }
        m_kernel.filter_row(row);
    });
    for (std::size_t k = 0; k < kinds.size(); ++k)
        std::swap(m_lights[k], m_others[k]);
}

void LightFilter::takeFitOut(LightImage& image) const {
    forEachRow(m_layers, [&](int y) {
        for (int c = 0; c < 3; ++c)
            for (int x = 0; x < m_layers.width(); ++x)
                image.color[c].row(y)[x] -= m_fitted[c].row(y)[x];
    });
}

void LightFilter::addFit(LightImage& image) const {
    forEachRow(m_layers, [&](int y) {
        for (int c = 0; c < 3; ++c)
            for (int x = 0; x < m_layers.width(); ++x) {
                float& light = image.color[c].row(y)[x];
                light = std::max(light + m_fitted[c].row(y)[x], 0.0F);
            }
    });
}

std::span<const LightImage> LightFilter::filtered(std::span<const LightSums> kinds) {
    for (std::size_t k = 0; k < kinds.size(); ++k) {
        readLight(kinds[k], m_lights[k], m_others[k].variance);
        smoothVariance(m_others[k].variance, m_lights[k].variance);
    }
    const bool is_fitted = kinds.front().follows_surfaces;
    if (is_fitted) {
        m_fit.fit(kinds.front(), m_fitted);
        takeFitOut(m_lights[0]);
    }
    for (const int step : {1, 2, 4, 8})
        pass(step, kinds);
    if (is_fitted)
        addFit(m_lights[0]);
    return {m_lights, kinds.size()};
}

} // namespace quarn
