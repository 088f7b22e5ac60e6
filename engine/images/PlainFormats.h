#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// Appends a BMP file of the picture: 24 bits a pixel, rows from the bottom, each filled up to a
/// multiple of 4 bytes.
/// @return why it cannot be made, a part of a sentence: the file would pass 4 GB
Result<void> encodeBmp(const ImageView& image, std::vector<std::byte>& bytes);

/// Appends a TGA file of the picture: true colour, not compressed, 24 bits a pixel, rows from the
/// bottom.
/// @return why it cannot be made, a part of a sentence: a side is longer than 65535 pixels
Result<void> encodeTga(const ImageView& image, std::vector<std::byte>& bytes);

} // namespace quarn
