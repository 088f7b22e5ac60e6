#include "quarn/console/TypedPlace.h"

#include "host/cities/Cities.h"
#include "host/cities/LocationChoice.h"
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
    return wideText(whyNoCity(typed) + " A latitude and a longitude do as well, as in 51.5 -0.12.");
}

std::wstring textFromPlace(const Place& place) {
    return textFromAngle(place.latitude_deg) + L" " + textFromAngle(place.longitude_deg);
}

} // namespace quarn::program
