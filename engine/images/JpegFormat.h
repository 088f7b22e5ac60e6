#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// Appends a JPEG file of the picture to `bytes`: quality 90, 4:4:4.
/// @return why it cannot be made, a part of a sentence
Result<void> encodeJpeg(const ImageView& image, std::vector<std::byte>& bytes);

} // namespace quarn
