#include "quarn/console/TypedPlace.h"

#include "host/front_end/Cities.h"
#include "host/front_end/LocationChoice.h"
#include "quarn/words/Words.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace quarn::program {

namespace {

/// Every pair of angles that a text may mean. A comma may part the angles, and may be the decimal
/// mark of either.
std::vector<Place> anglePairs(std::wstring_view text) {
    constexpr std::wstring_view SEPARATORS = L" \t,;";
    std::vector<Place> pairs;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (SEPARATORS.find(text[i]) == std::wstring_view::npos)
            continue;
        const auto latitude = angleFromText(text.substr(0, i), L'N');
        const auto longitude = angleFromText(text.substr(i + 1), L'E');
        const auto isSame = [&](const Place& pair) {
            return pair.latitude_deg == *latitude && pair.longitude_deg == *longitude;
        };
        if (latitude && longitude && std::ranges::none_of(pairs, isSame))
            pairs.push_back({*latitude, *longitude});
    }
    return pairs;
}

bool isOnEarth(const Place& place) {
    return std::abs(place.latitude_deg) <= 90.0 && std::abs(place.longitude_deg) <= 180.0;
}

/// "Athens, Greece; Accra, Ghana".
std::string namesOf(const std::vector<const City*>& cities) {
    std::string names;
    for (const City* const city : cities)
        names += (names.empty() ? "" : "; ") + std::string(city->name) + ", " +
                 std::string(city->country);
    return names;
}

std::wstring whyNoCity(const std::string& typed) {
    const std::vector<const City*> like = citiesLike(typed);
    const std::string hint = like.empty() ? "Type a latitude and a longitude, as in 51.5 -0.12."
                                          : "Is it one of these: " + namesOf(like) + "?";
    return wideText("No one city is called \"" + typed + "\". " + hint);
}

} // namespace

std::variant<Place, std::wstring> placeFromText(std::wstring_view text) {
    const std::vector<Place> pairs = anglePairs(text);
    if (pairs.size() > 1)
        return L"Part the latitude and the longitude with a semicolon.";
    if (!pairs.empty() && !isOnEarth(pairs.front()))
        return L"A place has a latitude from -90 to 90 and a longitude from -180 to 180.";
    if (!pairs.empty())
        return pairs.front();
    const std::string typed = utf8Text(text);
    const City* const city = findCity(typed);
    if (city)
        return Place{city->latitude_deg, city->longitude_deg};
    return whyNoCity(typed);
}

std::wstring textFromPlace(const Place& place) {
    return textFromAngle(place.latitude_deg) + L" " + textFromAngle(place.longitude_deg);
}

} // namespace quarn::program
