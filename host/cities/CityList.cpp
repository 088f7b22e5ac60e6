#include "host/cities/Cities.h"
#include "host/cities/CityAliases.h"
#include "host/cities/CitySpelling.h"

#include <algorithm>
#include <optional>
#include <string>

namespace quarn {
namespace {

struct Typed {
    std::string name;
    std::string country; ///< behind the last comma; empty for any
};

Typed typedCity(std::string_view text) {
    const std::size_t comma = text.rfind(',');
    if (comma == std::string_view::npos)
        return {comparedName(text), {}};
    return {comparedName(text.substr(0, comma)), comparedName(text.substr(comma + 1))};
}

bool beginsLike(std::string_view name, const std::string& typed) {
    return comparedName(name).starts_with(typed);
}

bool countryBeginsLike(const City& city, const std::string& typed) {
    return beginsLike(city.country, typed) ||
           std::ranges::any_of(countryAliases(), [&](const CityAlias& other) {
               return other.name == city.country && beginsLike(other.alias, typed);
           });
}

bool anotherNameBeginsLike(const City& city, const std::string& typed) {
    return std::ranges::any_of(cityAliases(), [&](const CityAlias& other) {
        return beginsLike(other.alias, typed) && findCity(other.alias) == &city;
    });
}

bool aWordBeginsLike(std::string_view name, const std::string& typed) {
    for (std::size_t index = 0; index < name.size(); ++index) {
        const bool ends_a_word = name[index] == ' ' || name[index] == '-';
        if (ends_a_word && beginsLike(name.substr(index + 1), typed))
            return true;
    }
    return false;
}

/// How a city was found: 0 by a name, 1 by a word of its name, 2 by its country.
std::optional<int> foundBy(const City& city, const Typed& typed) {
    if (!countryBeginsLike(city, typed.country))
        return {};
    if (beginsLike(city.name, typed.name) || anotherNameBeginsLike(city, typed.name))
        return 0;
    if (aWordBeginsLike(city.name, typed.name))
        return 1;
    if (typed.country.empty() && countryBeginsLike(city, typed.name))
        return 2;
    return {};
}

} // namespace

std::vector<const City*> citiesOf(std::string_view text) {
    const Typed typed = typedCity(text);
    std::vector<const City*> listed[3];
    for (const City& city : cities()) {
        if (const auto by = foundBy(city, typed))
            listed[*by].push_back(&city);
    }
    std::vector<const City*> result = std::move(listed[0]);
    result.insert(result.end(), listed[1].begin(), listed[1].end());
    result.insert(result.end(), listed[2].begin(), listed[2].end());
    return result.empty() ? citiesLike(text) : result;
}

} // namespace quarn
