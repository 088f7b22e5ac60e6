#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace quarn {

/// The contents of a text file in UTF-16 in UTF-8, for the reading library.
/// @param format  the extension in lower case
/// @return nothing for any other file, and for formats that are no text
std::optional<std::string> utf8OfWideFile(std::string_view format,
                                          std::span<const std::uint8_t> bytes);

} // namespace quarn
