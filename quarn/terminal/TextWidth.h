#pragma once

#include <cstddef>
#include <string_view>

namespace quarn::program {

/// The columns that a text takes on a terminal: two for each East Asian wide or fullwidth
/// character, none for a combining mark, one for any other.
///
/// Unicode Standard Annex #11, East Asian Width; neutral and ambiguous characters count as narrow.
std::size_t textWidth(std::wstring_view text);

} // namespace quarn::program
