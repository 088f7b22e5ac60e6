#pragma once

#include "host/display/Image.h"

#include <cstddef>

namespace quarn {

class LightFilter;
class RenderLayers;

/// Bytes that encodeRender takes for a pixel beside the picture.
inline constexpr std::size_t render_encoding_bytes = 3 * sizeof(float);

/// Puts the sums together and shows them as Rendered mode does.
void encodeRender(const RenderLayers& layers, int samples, LightFilter& filter, Image& image);

} // namespace quarn
