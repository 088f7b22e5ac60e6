#include "import/ifc/IfcPlace.h"

#include <charconv>
#include <cmath>
#include <numbers>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

namespace {

/// The texts between the commas of the outermost parentheses; `text` begins behind the opening one.
std::vector<std::string_view> argumentsIn(std::string_view text) {
    std::vector<std::string_view> arguments;
    int depth = 0;
    bool is_quoted = false;
    std::size_t begin = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        is_quoted = is_quoted != (c == '\''); // a doubled quote closes and opens again
        if (is_quoted)
            continue;
        if ((c == ',' || c == ')') && depth == 0) {
            arguments.push_back(text.substr(begin, i - begin));
            begin = i + 1;
        }
        if (c == ')' && depth == 0)
            return arguments;
        depth += c == '(' ? 1 : c == ')' ? -1 : 0;
    }
    return {}; // cut off
}

/// The arguments of the first entity of a kind; none where there is none.
std::vector<std::string_view> firstOf(std::string_view text, std::string_view kind) {
    for (std::size_t at = text.find(kind); at != std::string_view::npos;
         at = text.find(kind, at + 1)) {
        const std::size_t begin = at + kind.size();
        const char before = at > 0 ? text[at - 1] : ' ';
        if (begin < text.size() && text[begin] == '(' && (before == '=' || before == ' '))
            return argumentsIn(text.substr(begin + 1));
    }
    return {};
}

/// The numbers of a list in parentheses; none where it is no such list.
std::vector<double> numbersOf(std::string_view list) {
    std::vector<double> numbers;
    const std::size_t open = list.find('(');
    if (open == std::string_view::npos)
        return {};
    for (const std::string_view argument : argumentsIn(list.substr(open + 1))) {
        const std::size_t first = argument.find_first_not_of(" \t\r\n+");
        double number = 0.0;
        const char* const end = argument.data() + argument.size();
        if (first == std::string_view::npos ||
            std::from_chars(argument.data() + first, end, number).ec != std::errc())
            return {};
        numbers.push_back(number);
    }
    return numbers;
}

/// Degrees, minutes, seconds and millionths of a second, all of one sign.
std::optional<double> degreesOf(std::string_view list) {
    constexpr double IN_A_DEGREE[] = {1.0, 60.0, 3600.0, 3600.0e6};
    const std::vector<double> parts = numbersOf(list);
    if (parts.size() < 3 || parts.size() > 4)
        return std::nullopt;
    double degrees = 0.0;
    for (std::size_t i = 0; i < parts.size(); ++i)
        degrees += parts[i] / IN_A_DEGREE[i];
    return degrees;
}

/// To some ten centimetres on the ground: what is behind that is the rounding of the sum.
double shortened(double degrees) {
    return std::round(degrees * 1e6) / 1e6;
}

/// Degrees from the Y axis to the direction that an IfcDirection gives, clockwise.
double northAngleOf(std::string_view text) {
    constexpr std::size_t TRUE_NORTH = 5;
    const auto context = firstOf(text, "IFCGEOMETRICREPRESENTATIONCONTEXT");
    if (context.size() <= TRUE_NORTH || !context[TRUE_NORTH].starts_with('#'))
        return 0.0;
    const std::string id(context[TRUE_NORTH]);
    for (const char* assigned : {"=", " ="}) {
        for (const char* before : {"\n", ";", " "}) {
            const std::size_t at = text.find(before + id + assigned);
            if (at == std::string_view::npos)
                continue;
            const std::size_t open = text.find('(', at);
            const auto ratios = open == std::string_view::npos ? std::vector<double>()
                                                               : numbersOf(text.substr(open + 1));
            if (ratios.size() < 2 || (ratios[0] == 0.0 && ratios[1] == 0.0))
                return 0.0;
            const double angle = std::atan2(ratios[0], ratios[1]) * 180.0 / std::numbers::pi;
            return std::isfinite(angle) ? std::fmod(angle + 360.0, 360.0) : 0.0;
        }
    }
    return 0.0;
}

} // namespace

std::optional<ImportedPlace> placeOfIfc(std::span<const std::uint8_t> bytes) {
    constexpr std::size_t LATITUDE = 9;
    constexpr std::size_t LONGITUDE = 10;
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    const auto site = firstOf(text, "IFCSITE");
    if (site.size() <= LONGITUDE)
        return std::nullopt;
    const auto latitude = degreesOf(site[LATITUDE]);
    const auto longitude = degreesOf(site[LONGITUDE]);
    if (!latitude || !longitude || !(std::abs(*latitude) <= 90.0) ||
        !(std::abs(*longitude) <= 180.0))
        return std::nullopt;
    return ImportedPlace{shortened(*latitude), shortened(*longitude),
                         shortened(northAngleOf(text))};
}

} // namespace quarn
