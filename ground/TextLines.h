#pragma once

#include "ground/Result.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

/// Reads a text file in UTF-8, with or without a byte-order mark, and splits it at line breaks of
/// either kind.
/// @return the lines without their breaks; an error when the file is missing or cannot be read
Result<std::vector<std::wstring>> readTextLines(const std::filesystem::path& file);

} // namespace quarn
