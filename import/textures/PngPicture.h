#pragma once

#include "import/textures/PictureSize.h"

namespace quarn {

extern const PictureFormat PNG_PICTURES;

} // namespace quarn
