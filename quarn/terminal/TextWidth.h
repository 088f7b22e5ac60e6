#pragma once

#include <cstddef>
#include <string_view>

namespace quarn::program {

/// The columns that a text takes on a terminal, as the C library counts them: two for each wide
/// character of East Asia, none for a combining or a control character.
std::size_t textWidth(std::wstring_view text);

} // namespace quarn::program
