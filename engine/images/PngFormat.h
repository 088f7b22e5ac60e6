#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// Appends a PNG file of the picture to `bytes`.
/// @return why it cannot be made, a part of a sentence
Result<void> encodePng(const ImageView& image, std::vector<std::byte>& bytes);

} // namespace quarn
