#include "quarn/scripts/StudySite.h"

#include "host/front_end/Cities.h"
#include "quarn/words/Words.h"

#include <cmath>

namespace quarn::program {

namespace {

constexpr std::size_t MOST_SUGGESTIONS = 3;

std::string fullName(const City& city) {
    return std::string(city.name) + ", " + std::string(city.country);
}

/// "did you mean Athens, Greece or Accra, Ghana?"
std::string suggestions(const std::string& typed) {
    const std::vector<const City*> cities = citiesLike(typed);
    const std::size_t count = std::min(cities.size(), MOST_SUGGESTIONS);
    std::string text;
    for (std::size_t i = 0; i < count; ++i)
        text += (i == 0 ? "did you mean " : i + 1 == count ? " or " : "; ") + fullName(*cities[i]);
    return text.empty() ? "quarn places lists those that are known." : text + "?";
}

void takePlace(const std::string& typed, StudySite& site, FirstMistake& mistake) {
    const City* const city = findCity(typed);
    if (!city) {
        mistake.note("--place \"" + typed + "\" is not the name of one place; " +
                     suggestions(typed));
        return;
    }
    site.place = fullName(*city);
    site.latitude_deg = city->latitude_deg;
    site.longitude_deg = city->longitude_deg;
}

double angle(const std::string& option, const std::string& typed, double limit_deg,
             FirstMistake& mistake) {
    const std::optional<double> degrees = realNumber(typed);
    const bool is_good = degrees && std::abs(*degrees) <= limit_deg;
    if (!is_good)
        mistake.note(option + " must be a number of degrees from " + numberText(-limit_deg) +
                     " to " + numberText(limit_deg) + notBut(typed));
    return is_good ? *degrees : 0.0;
}

void takeCoordinates(const SiteOptions& typed, StudySite& site, FirstMistake& mistake) {
    if (!typed.latitude_deg && !typed.longitude_deg)
        mistake.note("say where the model stands with --place, or with --latitude and "
                     "--longitude; quarn places lists the places.");
    else if (!typed.latitude_deg || !typed.longitude_deg)
        mistake.note("--latitude and --longitude go together.");
    else {
        site.latitude_deg = angle("--latitude", *typed.latitude_deg, 90.0, mistake);
        site.longitude_deg = angle("--longitude", *typed.longitude_deg, 180.0, mistake);
    }
}

std::string coordinateText(double degrees, char positive, char negative) {
    return numberText(std::abs(degrees)) + " " + (degrees < 0.0 ? negative : positive);
}

} // namespace

StudySite checkSite(const SiteOptions& options, FirstMistake& mistake) {
    StudySite site{};
    if (options.place && (options.latitude_deg || options.longitude_deg))
        mistake.note("give either --place, or --latitude and --longitude.");
    if (options.place)
        takePlace(*options.place, site, mistake);
    else
        takeCoordinates(options, site, mistake);
    site.north_deg = angle("--north", options.north_deg, 360.0, mistake);
    return site;
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
