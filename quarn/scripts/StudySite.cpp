#include "quarn/scripts/StudySite.h"

#include "quarn/words/Words.h"

#include <cmath>

namespace quarn::program {

namespace {

constexpr std::size_t MOST_SUGGESTIONS = 3;

std::string coordinateText(double degrees, char positive, char negative) {
    return numberText(std::abs(degrees)) + " " + (degrees < 0.0 ? negative : positive);
}

} // namespace

std::string fullName(const City& city) {
    return std::string(city.name) + ", " + std::string(city.country);
}

std::string placeSuggestions(const std::string& typed) {
    const std::vector<const City*> cities = citiesLike(typed);
    const std::size_t count = std::min(cities.size(), MOST_SUGGESTIONS);
    std::string text;
    for (std::size_t i = 0; i < count; ++i)
        text += (i == 0 ? "did you mean " : i + 1 == count ? " or " : "; ") + fullName(*cities[i]);
    return text.empty() ? "quarn places lists those that are known." : text + "?";
}

double eastwardLongitude(double longitude_deg) {
    if (longitude_deg >= 0.0)
        return longitude_deg;
    // A billionth of a degree is a tenth of a millimetre; what the sum rounds off is less.
    constexpr double BILLION = 1e9;
    return std::round((longitude_deg + 360.0) * BILLION) / BILLION;
}

int zoneHours(double longitude_deg) {
    return static_cast<int>(longitude_deg * 24.0 / 360.0);
}

std::string zoneText(int hours) {
    if (hours == 0)
        return "UTC";
    return (hours > 0 ? "UTC+" : "UTC") + std::to_string(hours);
}

std::string latitudeText(double latitude_deg) {
    return coordinateText(latitude_deg, 'N', 'S');
}

std::string longitudeText(double longitude_deg) {
    return coordinateText(longitude_deg, 'E', 'W');
}

} // namespace quarn::program
