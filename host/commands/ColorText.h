#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_wString.h"

#include <optional>
#include <string_view>

namespace quarn {

/// A colour as a person writes it: six digits of red, green and blue in hexadecimal, with or
/// without
/// "#" before them, or black, grey or white; in any case.
/// @return nothing for any other text
std::optional<KM_Color> colorFromText(std::wstring_view text);

/// Why a text is no colour, in the user's language.
KM_wString noColorText(const wchar_t* text);

/// "#ff8800"
KM_wString colorText(const KM_Color& color);

} // namespace quarn
