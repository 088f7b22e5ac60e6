#pragma once

#include "import/textures/PictureSize.h"

namespace quarn {

/// AVIF, where the library libavif is installed; without it no file is known.
extern const PictureFormat AVIF_PICTURES;

} // namespace quarn
