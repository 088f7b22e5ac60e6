#include "host/cities/Cities.h"
#include "host/cities/CityAliases.h"
#include "host/cities/CitySpelling.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <optional>
#include <string>

namespace quarn {
namespace {

constexpr std::size_t MOST_SUGGESTIONS = 5;

/// A name as it was asked for, ready to be compared.
struct Wanted {
    std::string name;
    std::optional<std::string> country; ///< after the last comma
};

Wanted wantedCity(std::string_view text) {
    const std::size_t comma = text.rfind(',');
    if (comma == std::string_view::npos)
        return {comparedName(text), {}};
    std::string country = comparedName(text.substr(comma + 1));
    for (const CityAlias& other : countryAliases()) {
        if (comparedName(other.alias) == country)
            country = comparedName(other.name);
    }
    return {comparedName(text.substr(0, comma)), country};
}

/// The other name as the table has it; nothing when it is none.
std::optional<std::string_view> aliasedName(const std::string& name) {
    for (const CityAlias& other : cityAliases()) {
        if (comparedName(other.alias) == name)
            return other.name;
    }
    return {};
}

/// The one city of a name; null for none and for several.
const City* onlyCity(const Wanted& wanted) {
    const City* found = nullptr;
    for (const City& city : cities()) {
        if (comparedName(city.name) != wanted.name)
            continue;
        if (wanted.country && comparedName(city.country) != *wanted.country)
            continue;
        if (found)
            return nullptr;
        found = &city;
    }
    return found;
}

/// How far a city's name is from what was written: 0 the same, 1 it begins like it, from 2 on by
/// the letters that differ. Nothing where it is another name altogether.
std::optional<int> distance(const std::string& written, const std::string& name) {
    if (name == written)
        return 0;
    if (name.starts_with(written))
        return 1;
    const int letters = lettersApart(written, name);
    const int allowed = written.size() < 4 ? 1 : written.size() < 8 ? 2 : 3;
    return letters <= allowed ? std::optional(1 + letters) : std::nullopt;
}

struct Suggestion {
    const City* city;
    int distance;
};

void suggest(std::vector<Suggestion>& suggestions, const City* city, std::optional<int> distance) {
    if (!city || !distance)
        return;
    const auto same = std::ranges::find(suggestions, city, &Suggestion::city);
    if (same == suggestions.end())
        suggestions.push_back({city, *distance});
    else
        same->distance = std::min(same->distance, *distance);
}

/// "Birmingham, United Kingdom; Birmingham, United States".
std::string namesOf(const std::vector<const City*>& cities) {
    std::string names;
    for (const City* city : cities)
        names += (names.empty() ? "" : "; ") + nameWithCountry(*city);
    return names;
}

/// Of the straight line between two places through a sphere: it grows with their distance.
double squaredChord(const City& city, double latitude_deg, double longitude_deg) {
    constexpr double RADIANS = std::numbers::pi / 180.0;
    const double north = std::sin(0.5 * RADIANS * (city.latitude_deg - latitude_deg));
    const double east = std::sin(0.5 * RADIANS * (city.longitude_deg - longitude_deg));
    return north * north +
           std::cos(RADIANS * city.latitude_deg) * std::cos(RADIANS * latitude_deg) * east * east;
}

} // namespace

const City* findCity(std::string_view name) {
    if (const auto other = aliasedName(comparedName(name)))
        return onlyCity(wantedCity(*other));
    const Wanted wanted = wantedCity(name);
    if (const City* city = onlyCity(wanted))
        return city;
    const City* aliased = nullptr;
    if (const auto other = aliasedName(wanted.name))
        aliased = onlyCity(wantedCity(*other));
    const bool is_there = aliased && comparedName(aliased->country) == wanted.country;
    return is_there ? aliased : nullptr;
}

std::vector<const City*> citiesLike(std::string_view name) {
    const std::string written = wantedCity(name).name;
    if (written.empty())
        return {};
    std::vector<Suggestion> suggestions;
    for (const City& city : cities())
        suggest(suggestions, &city, distance(written, comparedName(city.name)));
    for (const CityAlias& other : cityAliases())
        suggest(suggestions, onlyCity(wantedCity(other.name)),
                distance(written, comparedName(other.alias)));
    std::ranges::stable_sort(suggestions, {}, &Suggestion::distance);
    std::vector<const City*> result;
    for (const Suggestion& suggestion : suggestions) {
        if (result.size() < MOST_SUGGESTIONS)
            result.push_back(suggestion.city);
    }
    return result;
}

const City& nearestCity(double latitude_deg, double longitude_deg) {
    return *std::ranges::min_element(cities(), {}, [&](const City& city) {
        return squaredChord(city, latitude_deg, longitude_deg);
    });
}

std::string nameWithCountry(const City& city) {
    return std::string(city.name) + ", " + std::string(city.country);
}

std::string whyNoCity(std::string_view name) {
    const std::string quoted = "\"" + std::string(name) + "\"";
    const std::vector<const City*> like = citiesLike(name);
    std::vector<const City*> same = like;
    std::erase_if(same,
                  [&](const City* city) { return comparedName(city->name) != comparedName(name); });
    if (same.size() > 1)
        return "Several cities are called " + quoted + ": " + namesOf(same) +
               ". Give the country too.";
    const std::string none = "There is no city " + quoted + " in the list.";
    return like.empty() ? none : none + " Is it one of these: " + namesOf(like) + "?";
}

} // namespace quarn
