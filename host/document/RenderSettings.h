#pragma once

#include "host/document/LightChoice.h"

namespace quarn {

/// What pictures the renderer makes, and what light they show; display modes show it too.
struct RenderSettings {
    int width_px = 1280;
    int height_px = 720;
    int samples = 64;        ///< of a pixel, by Render; 1 to RenderRequest::most_samples
    int preview_samples = 4; ///< of a pixel, by RenderPreview
    LightChoice light = {};

    friend bool operator==(const RenderSettings&, const RenderSettings&) = default;
};

} // namespace quarn
