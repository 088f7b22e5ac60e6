#pragma once

#include "import/textures/PictureSize.h"

namespace quarn {

/// JPEG, BMP, TGA and GIF (its first frame).
extern const PictureFormat PLAIN_PICTURES;

} // namespace quarn
