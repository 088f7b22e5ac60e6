#pragma once

#include "engine/render/LightFit.h"
#include "engine/render/PixelPlane.h"
#include "engine/render/RenderLayers.h"

#include <span>

namespace quarn {

/// Light without the colour of the surface, for each pixel, and how uncertain it is.
struct LightImage {
    LightImage(int width, int height);

    PixelPlane color[3];
    PixelPlane variance; ///< of its brightness
};

/// Takes noise out of sampled light, by averages over surfaces and never over edges. The surer the
/// samples are, the less it changes; shadows and mirrored pictures keep their borders. Of light
/// that follows surfaces it averages what its fit leaves over.
class LightFilter {
public:
    /// @param parallel_scene_size  in a parallel view, the size of what is seen, model units; else
    /// 0
    LightFilter(const RenderLayers& layers, float parallel_scene_size, const RenderKernel& kernel);

    /// Filters up to two kinds of light, which takes little longer than one; the first alone may
    /// be one that follows surfaces.
    /// @return an image of each; valid until the next call
    std::span<const LightImage> filtered(std::span<const LightSums> kinds);

    /// Bytes that a pixel takes.
    static constexpr std::size_t bytes_per_pixel = 27 * sizeof(float) + LightFit::bytes_per_pixel;

private:
    void readGuides();
    void readSlopes();
    void readLight(const LightSums& kind, LightImage& image, PixelPlane& variance) const;
    void smoothVariance(const PixelPlane& from, PixelPlane& to) const;
    void takeFitOut(LightImage& image) const;
    void addFit(LightImage& image) const;
    void pass(int step, std::span<const LightSums> kinds);

    const RenderLayers& m_layers;
    const RenderKernel& m_kernel;
    PixelPlane m_normal[3];
    PixelPlane m_nearness;
    PixelPlane m_slope[2];
    PixelPlane m_tolerance;
    PixelPlane m_cover;
    LightFit m_fit;
    PixelPlane m_fitted[3];
    LightImage m_lights[most_filter_lights];
    LightImage m_others[most_filter_lights];
    float m_nearness_share;
    float m_nearness_tolerance;
};

} // namespace quarn
