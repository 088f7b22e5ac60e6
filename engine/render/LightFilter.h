#pragma once

#include "engine/render/RenderLayers.h"

#include <vector>

namespace quarn {

/// Light without the colour of the surface, for each pixel, and how uncertain it is.
struct LightImage {
    std::vector<float> color[3];
    std::vector<float> variance; ///< of its brightness
};

/// Takes noise out of sampled light, by averages over surfaces and never over edges. The surer the
/// samples are, the less it changes; shadows keep their borders.
class LightFilter {
public:
    /// @param scene_size  in a parallel view, the size of what is seen, model units; else 0
    LightFilter(const RenderLayers& layers, float parallel_scene_size, const RenderKernel& kernel);

    /// The light of one kind.
    /// @param first   RenderPlane::sky_r or sun_r
    /// @param square  RenderPlane::sky_square or sun_square
    /// @return the filtered light; valid until the next call
    const LightImage& filtered(int first, int square);

    /// Bytes that a pixel takes.
    static constexpr std::size_t bytes_per_pixel = 16 * sizeof(float);

private:
    void readGuides();
    void readSlopes();
    void readLight(int first, int square);
    void smoothVariance();
    void pass(int step);

    const RenderLayers& m_layers;
    const RenderKernel& m_kernel;
    std::vector<float> m_normal[3];
    std::vector<float> m_nearness;
    std::vector<float> m_slope[2];
    std::vector<float> m_cover;
    LightImage m_light;
    LightImage m_other;
    std::vector<float> m_weight;
    float m_nearness_share;
    float m_nearness_tolerance;
};

} // namespace quarn
