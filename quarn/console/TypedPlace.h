#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <string>
#include <string_view>
#include <variant>

namespace quarn::program {

/// Reads a place as a person types it: the name of a city, or a latitude and a longitude with a
/// blank, a comma or a semicolon between them ("Athens", "51.5 -0.12", "51,5; -0,12",
/// "33.87S 151.21E").
///
/// @return the place; else one sentence that says why there is none, and what to type instead
std::variant<Place, std::wstring> placeFromText(std::wstring_view text);

/// A place as placeFromText reads it back, to four decimals: "51.5 -0.12".
std::wstring textFromPlace(const Place& place);

} // namespace quarn::program
