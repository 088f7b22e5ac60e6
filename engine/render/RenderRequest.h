#pragma once

namespace quarn {

/// The size of a picture and how often each of its pixels is looked at.
struct RenderRequest {
    static constexpr int most_samples = 16384;

    int width_px = 0;  ///< 1 to DisplayPipeline::max_size_px
    int height_px = 0; ///< the same
    int samples = 1;   ///< 1 to most_samples
};

/// How a rendering ended: with a whole picture, or given up by whoever watches it.
enum class RenderEnd { done, cancelled };

} // namespace quarn
