#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace quarn {

/// The last few hundred bytes of a file, in which formats of text say that it is whole.
std::string_view endOfFile(std::span<const std::uint8_t> bytes);

/// What a person is told where a file does not say so.
inline constexpr const char* CUT_OFF_TEXT =
    "The file's end is missing: it was cut off, and parts of the model may be missing with it.";

} // namespace quarn
