#pragma once

#include "engine/render/LightSums.h"
#include "engine/render/PixelPlane.h"
#include "engine/render/RenderLayers.h"

#include <vector>

namespace quarn {

/// Explains light by the surfaces that pixels show. Where surfaces meet in a pixel, its light, its
/// normal, its albedo and its nearness are the same mixture of theirs; so around each tile the
/// light is fitted as a linear function of these, over squares of three by three tiles that
/// overlap (K. He, J. Sun and X. Tang, "Guided Image Filtering", ECCV 2010; the features are those
/// of B. Bitterli et al., "Nonlinearly Weighted First-order Regression for Denoising Monte Carlo
/// Renderings", Computer Graphics Forum 35(4), 2016).
class LightFit {
public:
    /// @param parallel_scene_size  in a parallel view, the size of what is seen, model units; else
    /// 0
    LightFit(const RenderLayers& layers, float parallel_scene_size);

    /// @param fitted  takes the red, green and blue of the light, without the albedo that is in it
    void fit(const LightSums& kind, PixelPlane (&fitted)[3]);

private:
    static constexpr int feature_count = 8; ///< normal, albedo, nearness, cover
    static constexpr int nearness_index = 6;

    /// Sums over pixels, each as often as it has samples.
    struct Moments {
        float weight;
        float feature[feature_count];
        float light[3];
        float light_light;
        float feature_light[feature_count][3];
        float feature_feature[feature_count * (feature_count + 1) / 2]; ///< row by row
    };

    /// Light as a linear function of the features.
    struct Fit {
        float constant[3];
        float slope[feature_count][3];
        float trust; ///< the more, the less the fit leaves unexplained
    };

    struct TilePixels;
    class FitBetween;

public:
    /// Bytes that a pixel takes.
    static constexpr std::size_t bytes_per_pixel =
        (sizeof(Moments) + 2 * sizeof(Fit)) / lane_count + 1;

private:
    TilePixels pixelsOf(std::size_t tile, const LightSums& kind) const;
    Moments momentsOf(std::size_t tile, const LightSums& kind) const;
    Moments momentsAround(int column, int row) const;
    Fit fitOf(const Moments& moments) const;
    Fit meanFitAround(int column, int row) const;
    void show(const LightSums& kind, int column, int row, PixelPlane (&fitted)[3]) const;
    std::size_t tileAt(int column, int row) const;
    template <class Work> void forTiles(const Work& work) const;
    template <class Work> void forTilesAround(int column, int row, const Work& work) const;

    const RenderLayers& m_layers;
    int m_columns;
    int m_rows;
    float m_nearness_share;
    float m_nearness_tolerance;
    std::vector<Moments> m_moments;
    std::vector<Fit> m_fits;
    std::vector<Fit> m_means; ///< of the fits that took each tile in
};

} // namespace quarn
