#pragma once

#include <span>
#include <string_view>

namespace quarn {

/// Another name under which people look for a city or a country.
struct CityAlias {
    std::string_view alias; ///< UTF-8, as it is written
    std::string_view name;  ///< the name in the table of the cities
};

/// Local and former names of cities that one city alone has.
std::span<const CityAlias> cityAliases();

/// Short and other names of countries.
std::span<const CityAlias> countryAliases();

} // namespace quarn
