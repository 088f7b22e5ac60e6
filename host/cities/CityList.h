#pragma once

#include "host/cities/Cities.h"

#include <string_view>
#include <vector>

namespace quarn {

/// The cities that somebody may mean who has typed so much of a name.
///
/// @param typed  UTF-8: the beginning of a city's name, of another name of it, of a word of it or
///               of its country; behind a comma the beginning of its country
/// @return those found by their name, then by a word, then by the country, each in the order of
///         cities(); where there is none, as citiesLike; for an empty text all cities
std::vector<const City*> citiesOf(std::string_view typed);

} // namespace quarn
