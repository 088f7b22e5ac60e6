#include "quarn/reports/PlaceList.h"

#include "host/cities/Cities.h"
#include "quarn/words/Words.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace quarn::program {

namespace {

using Row = std::array<std::wstring, 5>;

/// Two digits behind the point, as the table has them.
std::wstring coordinate(double degrees, wchar_t positive, wchar_t negative) {
    std::array<char, 16> text;
    const char* const end = std::to_chars(text.data(), text.data() + text.size(), std::abs(degrees),
                                          std::chars_format::fixed, 2)
                                .ptr;
    const std::wstring number(static_cast<const char*>(text.data()), end);
    return std::wstring(number.size() < 6 ? 6 - number.size() : 0, L' ') + number + L' ' +
           (degrees < 0.0 ? negative : positive);
}

Row rowOf(const City& city) {
    return {wideText(city.name), wideText(city.country), coordinate(city.latitude_deg, L'N', L'S'),
            coordinate(city.longitude_deg, L'E', L'W'), wideText(city.zone)};
}

std::string table(const std::vector<Row>& rows) {
    constexpr std::size_t GAP = 2;
    std::array<std::size_t, std::tuple_size_v<Row>> widths{};
    for (const Row& row : rows)
        for (std::size_t i = 0; i < row.size(); ++i)
            widths[i] = std::max(widths[i], row[i].size());
    std::wstring text;
    for (const Row& row : rows) {
        for (std::size_t i = 0; i + 1 < row.size(); ++i)
            text += row[i] + std::wstring(widths[i] + GAP - row[i].size(), L' ');
        text += row.back() + L"\n";
    }
    return utf8Text(text);
}

} // namespace

Outcome listPlaces(const std::string& text) {
    const std::vector<const City*> found = citiesOf(text);
    if (found.empty())
        return Outcome::failure("no place is called anything like \"" + text +
                                "\"; --latitude and --longitude take every place on earth.");
    std::vector<Row> rows = {{L"place", L"country", L"latitude", L"longitude", L"time zone"}};
    for (const City* const city : found)
        rows.push_back(rowOf(*city));
    return Outcome::success(table(rows));
}

} // namespace quarn::program
