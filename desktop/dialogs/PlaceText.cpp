#include "desktop/dialogs/PlaceText.h"

#include "desktop/texts/Texts.h"

#include <cmath>

namespace quarn::desktop {
namespace {

QString qtName(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

} // namespace

QString placeText(const Place& place) {
    const QString latitude =
        place.latitude_deg < 0 ? localized(L"%1° S", 45341) : localized(L"%1° N", 45340);
    const QString longitude =
        place.longitude_deg < 0 ? localized(L"%1° W", 45343) : localized(L"%1° E", 45342);
    return latitude.arg(std::abs(place.latitude_deg), 0, 'f', 2) + ", " +
           longitude.arg(std::abs(place.longitude_deg), 0, 'f', 2);
}

QString cityText(const City& city) {
    return qtName(city.name) + ", " + qtName(city.country);
}

} // namespace quarn::desktop
