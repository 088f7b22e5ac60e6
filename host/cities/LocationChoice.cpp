#include "host/cities/LocationChoice.h"

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <numbers>

namespace quarn {
namespace {

constexpr double LATITUDE_LIMIT_DEG = 90.0;
constexpr double LONGITUDE_LIMIT_DEG = 180.0;
constexpr int MOST_DECIMALS = 4;          // 11 metres
constexpr double HERE_DEG = 0.005 + 1e-9; // the cities are known to 0.01 degrees

wchar_t oppositeOf(wchar_t north) {
    return north == L'N' ? L'S' : L'W';
}

wchar_t upper(wchar_t letter) {
    return letter >= L'a' && letter <= L'z' ? letter - L'a' + L'A' : letter;
}

void trim(std::wstring_view& text) {
    constexpr std::wstring_view blanks = L" \t\u00A0\u202F";
    text.remove_prefix(std::min(text.find_first_not_of(blanks), text.size()));
    text.remove_suffix(text.size() - (text.find_last_not_of(blanks) + 1));
}

/// Takes the letter of a side of the earth from the end. @return -1 for the negative side
double takeSide(std::wstring_view& text, wchar_t north) {
    if (text.empty())
        return 1;
    const wchar_t last = upper(text.back());
    if (last != north && last != oppositeOf(north))
        return 1;
    text.remove_suffix(1);
    trim(text);
    return last == north ? 1 : -1;
}

std::optional<double> plainNumber(std::wstring_view text) {
    std::string digits;
    for (const wchar_t character : text) {
        if (character == L'\u2212')
            digits += '-';
        else if (character < 0x80)
            digits += character == L',' ? '.' : static_cast<char>(character);
        else
            return {};
    }
    if (digits.starts_with('+') && !digits.starts_with("+-"))
        digits.erase(0, 1);
    double number = 0.0;
    const char* const end = digits.data() + digits.size();
    const auto [stopped, error] =
        std::from_chars(digits.data(), end, number, std::chars_format::fixed);
    const bool is_number = error == std::errc() && stopped == end && std::isfinite(number);
    return is_number ? std::optional(number) : std::nullopt;
}

double radians(double angle_deg) {
    return angle_deg * std::numbers::pi / 180.0;
}

/// Grows with the distance along the great circle: the square of half the chord (the haversine,
/// R. W. Sinnott, "Virtues of the haversine", Sky and Telescope 68, 1984).
double farness(const Place& from, const City& city) {
    const double north = std::sin(radians(city.latitude_deg - from.latitude_deg) / 2);
    const double east = std::sin(radians(city.longitude_deg - from.longitude_deg) / 2);
    return north * north + std::cos(radians(from.latitude_deg)) *
                               std::cos(radians(city.latitude_deg)) * east * east;
}

bool isHere(const Place& place, const City& city) {
    return std::abs(place.latitude_deg - city.latitude_deg) <= HERE_DEG &&
           std::abs(place.longitude_deg - city.longitude_deg) <= HERE_DEG;
}

} // namespace

WorldMapPoint worldMapPoint(const Place& place, const WorldMapSize& size) {
    return {(place.longitude_deg + LONGITUDE_LIMIT_DEG) / 360.0 * size.width,
            (LATITUDE_LIMIT_DEG - place.latitude_deg) / 180.0 * size.height};
}

Place placeOnWorldMap(const WorldMapPoint& point, const WorldMapSize& size) {
    if (!(size.width > 0) || !(size.height > 0))
        return {};
    const double across = std::clamp(point.x / size.width, 0.0, 1.0);
    const double down = std::clamp(point.y / size.height, 0.0, 1.0);
    return {LATITUDE_LIMIT_DEG - down * 180.0, across * 360.0 - LONGITUDE_LIMIT_DEG};
}

std::optional<double> angleFromText(std::wstring_view text, wchar_t north) {
    trim(text);
    const double side = takeSide(text, north);
    if (text.ends_with(L'\u00B0')) {
        text.remove_suffix(1);
        trim(text);
    }
    const auto angle = plainNumber(text);
    return angle ? std::optional(side * *angle) : std::nullopt;
}

std::wstring textFromAngle(double angle_deg) {
    std::array<char, 400> digits = {}; // the greatest double has 309 digits before its point
    const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), angle_deg,
                                       std::chars_format::fixed, MOST_DECIMALS);
    std::wstring text(digits.data(), written.ptr);
    if (text.find(L'.') != std::wstring::npos) {
        text.erase(text.find_last_not_of(L'0') + 1);
        if (text.ends_with(L'.'))
            text.pop_back();
    }
    return text == L"-0" ? L"0" : text;
}

void LocationChoice::Angle::show(double angle_deg) {
    text = textFromAngle(angle_deg);
    value_deg = angle_deg;
    flaw = Flaw::none;
}

void LocationChoice::Angle::type(std::wstring_view typed, wchar_t north, double limit_deg) {
    if (typed == text)
        return; // the angle may be finer than its text
    text = typed;
    const auto angle = angleFromText(typed, north);
    value_deg = angle.value_or(0.0);
    flaw = !angle                             ? Flaw::no_number
           : std::abs(value_deg) <= limit_deg ? Flaw::none
                                              : Flaw::out_of_range;
}

LocationChoice::LocationChoice(const Place& start) {
    choose(start);
    search({});
}

void LocationChoice::typeLatitude(std::wstring_view text) {
    m_latitude.type(text, L'N', LATITUDE_LIMIT_DEG);
}

void LocationChoice::typeLongitude(std::wstring_view text) {
    m_longitude.type(text, L'E', LONGITUDE_LIMIT_DEG);
}

bool LocationChoice::isValid() const {
    return m_latitude.flaw == Flaw::none && m_longitude.flaw == Flaw::none;
}

std::optional<Place> LocationChoice::place() const {
    if (!isValid())
        return {};
    return Place{m_latitude.value_deg, m_longitude.value_deg};
}

void LocationChoice::choose(const Place& place) {
    m_latitude.show(std::clamp(place.latitude_deg, -LATITUDE_LIMIT_DEG, LATITUDE_LIMIT_DEG));
    m_longitude.show(std::clamp(place.longitude_deg, -LONGITUDE_LIMIT_DEG, LONGITUDE_LIMIT_DEG));
}

void LocationChoice::choose(const City& city) {
    choose(Place{city.latitude_deg, city.longitude_deg});
}

void LocationChoice::search(std::wstring_view text) {
    m_listed = citiesOf(KM_wString(text).ToUtf8());
}

const City* LocationChoice::cityHere() const {
    const auto here = place();
    const City* const nearest = nearestCity();
    return nearest && isHere(*here, *nearest) ? nearest : nullptr;
}

const City* LocationChoice::nearestCity() const {
    const auto here = place();
    if (!here)
        return nullptr;
    const auto nearest = std::ranges::min_element(
        cities(), {}, [&](const City& city) { return farness(*here, city); });
    return nearest == cities().end() ? nullptr : &*nearest;
}

} // namespace quarn
