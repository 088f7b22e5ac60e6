#pragma once

namespace quarn {

/// What pictures the renderer makes.
struct RenderSettings {
    static constexpr int most_samples = 16384;

    int width_px = 1280;
    int height_px = 720;
    int samples = 64;        ///< of a pixel, by Render; 1 to most_samples
    int preview_samples = 8; ///< of a pixel, by RenderPreview

    friend bool operator==(const RenderSettings&, const RenderSettings&) = default;
};

} // namespace quarn
