#pragma once

#include "engine/scene/Material.h"
#include "ground/Result.h"
#include "import/ReadingBudget.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <span>

namespace quarn {

/// The picture in the bytes of a PNG, JPEG, WebP, AVIF, BMP, TGA or GIF file (its first frame),
/// with repeating wrap modes. Pictures with a side over 16384 pixels or with more than 64 million
/// pixels are refused before memory is asked for, and so are those whose pixels the budget does not
/// hold.
/// @return the texture; or an error whose message is why, a part of a sentence
Result<Texture> decodeTexture(std::span<const std::uint8_t> bytes, ReadingBudget& budget);

/// The same for a file of at most 256 MB.
Result<Texture> readTextureFile(const std::filesystem::path& path, ReadingBudget& budget);

} // namespace quarn
