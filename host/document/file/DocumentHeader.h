#pragma once

#include <array>
#include <cstdint>

namespace quarn {

/// The first bytes of every document file. The high bit, the two kinds of line end and the
/// end-of-file character show at once when a file was sent as if it were text.
inline constexpr std::array<std::uint8_t, 8> DOCUMENT_MAGIC = {0x89, 'Q',  'R',  'N',
                                                               '\r', '\n', 0x1A, '\n'};

} // namespace quarn
