#include "quarn/scripts/StudySite.h"

#include "host/cities/Cities.h"
#include "quarn/words/Words.h"

#include <cmath>

namespace quarn::program {

namespace {

std::string coordinateText(double degrees, char positive, char negative) {
    return numberText(std::abs(degrees)) + " " + (degrees < 0.0 ? negative : positive);
}

} // namespace

double eastwardLongitude(double longitude_deg) {
    if (longitude_deg >= 0.0)
        return longitude_deg;
    // A billionth of a degree is a tenth of a millimetre; what the sum rounds off is less.
    constexpr double BILLION = 1e9;
    return std::round((longitude_deg + 360.0) * BILLION) / BILLION;
}

std::string placeName(const StudySite& site) {
    if (findCity(site.place))
        return site.place;
    return latitudeText(site.latitude_deg) + ", " + longitudeText(site.longitude_deg);
}

std::string latitudeText(double latitude_deg) {
    return coordinateText(latitude_deg, 'N', 'S');
}

std::string longitudeText(double longitude_deg) {
    return coordinateText(longitude_deg, 'E', 'W');
}

} // namespace quarn::program
