#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

namespace quarn {

/// The contents of a text in UTF-16, which its first two bytes tell, in UTF-8 without a mark.
/// @return nothing for any other text
std::optional<std::string> utf8OfWideText(std::span<const std::uint8_t> bytes);

} // namespace quarn
