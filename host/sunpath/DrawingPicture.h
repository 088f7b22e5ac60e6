#pragma once

#include "engine/images/Image.h"
#include "host/letters/Letters.h"
#include "host/sunpath/Drawing.h"

namespace quarn {

/// Draws a drawing as a picture on white.
/// @param scale  pixels of the picture for each of the drawing
Image pictureOf(const Drawing& drawing, double scale, const Letters& letters);

} // namespace quarn
