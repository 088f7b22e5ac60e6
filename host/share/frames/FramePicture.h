#pragma once

#include "engine/images/Image.h"
#include "ground/Result.h"

#include <filesystem>

namespace quarn {

/// Reads the picture of a recorded frame: JPEG, PNG, BMP or TGA.
/// @return an error, one sentence that names the file: it is missing, cannot be read, is no such
///         picture, is cut or damaged, or has more than 64 million pixels or a side over 16384
Result<Image> readFramePicture(const std::filesystem::path& file);

} // namespace quarn
