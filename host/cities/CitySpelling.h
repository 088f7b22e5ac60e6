#pragma once

#include <string>
#include <string_view>

namespace quarn {

/// A name as it is compared: small letters and digits alone. Accents of the Latin letters are
/// dropped, whether they stand in the letter or follow it; blanks and ASCII marks too. Characters
/// of other scripts stay as they are.
/// @param name  UTF-8
std::string comparedName(std::string_view name);

/// How many letters must be changed, put in, left out or swapped with their neighbour to turn one
/// text into the other, counted in bytes (optimal string alignment distance).
int lettersApart(std::string_view one, std::string_view other);

} // namespace quarn
