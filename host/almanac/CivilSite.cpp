#include "host/almanac/CivilSite.h"

#include <array>
#include <charconv>
#include <cmath>

namespace quarn {

namespace {

std::string coordinateText(double degrees, char positive, char negative) {
    std::array<char, 32> text;
    const auto written = std::to_chars(text.data(), text.data() + text.size(), std::abs(degrees));
    return std::string(text.data(), written.ptr) + " " + (degrees < 0.0 ? negative : positive);
}

} // namespace

Result<const City*> giveZone(CivilSite& site, std::string_view written) {
    const City* const own = findCity(site.place);
    const City* const near = own ? own : &nearestCity(site.latitude_deg, site.longitude_deg);
    const auto zone =
        written.empty() ? Zone::named(near->zone) : Zone::written(written, site.longitude_deg);
    if (!zone)
        return zone.error();
    site.zone = zone.value();
    return written.empty() && !own ? near : nullptr;
}

double eastwardLongitude(double longitude_deg) {
    if (longitude_deg >= 0.0)
        return longitude_deg;
    // A billionth of a degree is a tenth of a millimetre; what the sum rounds off is less.
    constexpr double BILLION = 1e9;
    return std::round((longitude_deg + 360.0) * BILLION) / BILLION;
}

std::string placeName(const CivilSite& site) {
    return findCity(site.place) ? site.place : coordinatesText(site);
}

std::string coordinatesText(const CivilSite& site) {
    return coordinateText(site.latitude_deg, 'N', 'S') + ", " +
           coordinateText(site.longitude_deg, 'E', 'W');
}

} // namespace quarn
