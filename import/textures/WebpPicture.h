#pragma once

#include "import/textures/PictureSize.h"

namespace quarn {

/// WebP; of moving pictures nothing is read.
extern const PictureFormat WEBP_PICTURES;

} // namespace quarn
