#pragma once

namespace quarn {

/// What pictures the renderer makes.
struct RenderSettings {
    int width_px = 1280;
    int height_px = 720;
    int samples = 64;        ///< of a pixel, by Render; 1 to RenderRequest::most_samples
    int preview_samples = 8; ///< of a pixel, by RenderPreview

    friend bool operator==(const RenderSettings&, const RenderSettings&) = default;
};

} // namespace quarn
