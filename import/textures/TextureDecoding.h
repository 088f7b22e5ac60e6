#pragma once

#include "engine/scene/Material.h"
#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <span>

namespace quarn {

/// The picture in the bytes of a PNG, JPEG, BMP, TGA or GIF file (its first frame), with repeating
/// wrap modes. Pictures with a side over 16384 pixels or with more than 64 million pixels are
/// refused before memory is asked for.
/// @return the texture; or an error whose message is why, a part of a sentence
Result<Texture> decodeTexture(std::span<const std::uint8_t> bytes);

/// The same for a file of at most 256 MB.
Result<Texture> readTextureFile(const std::filesystem::path& path);

} // namespace quarn
