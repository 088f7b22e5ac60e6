#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// Appends a JPEG file of the picture to `bytes`: 4:4:4.
/// @param quality  1 to 100
/// @return why it cannot be made, a part of a sentence
Result<void> encodeJpeg(const ImageView& image, int quality, std::vector<std::byte>& bytes);

} // namespace quarn
