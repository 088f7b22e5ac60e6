#pragma once

#include "kelmar/KM_wString.h"

#include <optional>
#include <string_view>

namespace quarn {

/// Reads a number whatever the locale: digits with a point, an optional sign and exponent, nothing
/// else around them but blanks.
/// @return nothing for any other text, for infinity and what is no number, and for a number that a
///         double cannot hold
std::optional<double> readNumber(std::wstring_view text);

/// Reads a whole number in decimal digits with an optional sign.
/// @return nothing for any other text, also "3.0", and for a number that an int cannot hold
std::optional<int> readWholeNumber(std::wstring_view text);

/// A text that reads back as the same number, whatever the locale, with as few digits as that
/// takes. It has no exponent from 0.00001 up to below 1e15, so that whole numbers read back as
/// such.
KM_wString numberText(double number);

} // namespace quarn
