#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <string_view>
#include <vector>

namespace quarn {

/// The bytes that a text of Base64 stands for (S. Josefsson, "The Base16, Base32, and Base64 Data
/// Encodings", RFC 4648, sections 4 and 5: either alphabet); padding may be missing.
/// @return an error, a part of a sentence, that names the first character that belongs to neither
Result<std::vector<std::uint8_t>> fromBase64(std::string_view text);

} // namespace quarn
