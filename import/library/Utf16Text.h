#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// The contents of a text file in UTF-16, which its first two bytes tell, in UTF-8.
/// @return nothing for any other file, and for formats that are no text
std::optional<std::string> utf8OfWideFile(const std::filesystem::path& path);

} // namespace quarn
