#pragma once

#include "engine/images/Image.h"

#include <cstddef>

namespace quarn {

class LightFilter;
class RenderLayers;
struct FrameSetup;

/// Bytes that encodeRender takes for a pixel beside the picture.
inline constexpr std::size_t render_encoding_bytes = 6 * sizeof(float);

/// Shows one row of the sums of some samples as they are, with their noise; grey where there is
/// none.
/// @param frame  tells of the background
/// @param image  has the size of the layers
void encodeRow(const RenderLayers& layers, const FrameSetup& frame, int y, Image& image);

/// Puts the sums together and shows them as Rendered mode does. Pixels before a clear background
/// get an opacity of their own.
/// @param frame  tells of the background
void encodeRender(const RenderLayers& layers, const FrameSetup& frame, LightFilter& filter,
                  Image& image);

} // namespace quarn
