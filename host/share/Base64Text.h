#pragma once

#include <cstddef>
#include <span>
#include <string>

namespace quarn {

/// Bytes as text, as addresses that begin with "data:" hold them (RFC 4648, with padding).
std::string base64Text(std::span<const std::byte> bytes);

} // namespace quarn
