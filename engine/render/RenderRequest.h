#pragma once

namespace quarn {

/// The size of a picture and how often its pixels are looked at.
struct RenderRequest {
    static constexpr int most_samples = 16384;

    int width_px = 0;  ///< 1 to DisplayPipeline::max_size_px
    int height_px = 0; ///< the same
    /// The most samples that a pixel gets, 1 to most_samples. Where fewer show the picture as
    /// surely as so many do elsewhere, fewer are taken.
    int samples = 1;
};

/// How a rendering ended: with a whole picture, or given up by whoever watches it.
enum class RenderEnd { done, cancelled };

} // namespace quarn
