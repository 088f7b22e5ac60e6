#pragma once

#include <string>
#include <string_view>

namespace quarn::program {

/// Text as it may be shown: a control character, which would steer the terminal, stands as its
/// number in hexadecimal, "\x1B". Line breaks and tabs stay.
std::wstring shownText(std::wstring_view text);
/// The same in UTF-8; what is no text becomes the replacement character.
std::string shownText(std::string_view utf8);

} // namespace quarn::program
