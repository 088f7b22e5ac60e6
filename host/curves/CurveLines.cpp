#include "host/curves/CurveDescription.h"

#include <array>
#include <charconv>
#include <optional>
#include <string>

namespace quarn {

namespace {

constexpr std::string_view BLANKS = " \t\r\f\v";

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(BLANKS);
    if (first == text.npos)
        return {};
    return text.substr(first, text.find_last_not_of(BLANKS) - first + 1);
}

/// Cuts the first line off.
std::string_view takeLine(std::string_view& rest) {
    const std::size_t end = rest.find('\n');
    const std::string_view line = rest.substr(0, end);
    rest = end == rest.npos ? std::string_view() : rest.substr(end + 1);
    return line;
}

/// Cuts the number before the next comma or blank off. Blanks beside a comma belong to it.
std::optional<double> takeNumber(std::string_view& rest) {
    if (rest.starts_with('+') && !rest.starts_with("+-"))
        rest.remove_prefix(1);
    double number = 0.0;
    const auto [end, error] = std::from_chars(rest.data(), rest.data() + rest.size(), number);
    if (error != std::errc() || !KM_IsValid(number))
        return std::nullopt;
    rest.remove_prefix(static_cast<std::size_t>(end - rest.data()));
    const std::string_view after = trimmed(rest);
    if (after.starts_with(',')) {
        rest = trimmed(after.substr(1));
        return rest.empty() ? std::nullopt : std::optional(number);
    }
    if (!after.empty() && after.size() == rest.size())
        return std::nullopt; // something stands right behind it
    rest = after;
    return number;
}

std::optional<KM_3dPoint> readPlace(std::string_view text) {
    std::array<double, 3> numbers{};
    for (double& number : numbers) {
        const std::optional<double> taken = takeNumber(text);
        if (!taken)
            return std::nullopt;
        number = *taken;
    }
    const KM_3dPoint place(numbers[0], numbers[1], numbers[2]);
    return text.empty() && place.IsValid() ? std::optional(place) : std::nullopt;
}

/// What a person sees of a line in a message: not all of a long one, and no control characters.
std::string quoted(std::string_view line) {
    std::string shown(line.substr(0, 40));
    for (char& character : shown)
        if (static_cast<unsigned char>(character) < 32 ||
            static_cast<unsigned char>(character) > 126)
            character = '?';
    return "\"" + shown + (line.size() > 40 ? "...\"" : "\"");
}

std::optional<int> readDegree(std::string_view text) {
    int degree = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), degree);
    const bool is_whole = error == std::errc() && end == text.data() + text.size();
    return is_whole && degree >= 1 && degree <= HIGHEST_DEGREE ? std::optional(degree)
                                                               : std::nullopt;
}

/// @return why the line cannot be taken; empty when it was
std::string takeDirective(std::string_view line, CurveDescription& curve) {
    if (!curve.points.empty())
        return quoted(line) + " is no point; \"degree\" and \"closed\" stand before the first one";
    if (line == "closed") {
        curve.closed = true;
        return {};
    }
    const std::optional<int> degree = readDegree(trimmed(line.substr(6)));
    if (!degree)
        return quoted(line) + " is no degree; write degree and a number from 1 to " +
               std::to_string(HIGHEST_DEGREE);
    curve.degree = *degree;
    return {};
}

bool isDirective(std::string_view line) {
    return line == "closed" || line == "degree" || line.starts_with("degree ") ||
           line.starts_with("degree\t");
}

std::string takePoint(std::string_view line, CurveDescription& curve) {
    if (curve.points.size() == CurveDescription::MOST_POINTS)
        return "there are more than a million points";
    const std::optional<KM_3dPoint> place = readPlace(line);
    if (!place)
        return quoted(line) + " is no point; write x y z or x,y,z";
    curve.points.push_back(*place);
    curve.weights.push_back(1.0);
    return {};
}

} // namespace

Error errorInLine(std::size_t line, std::string_view why) {
    return Error{"line " + std::to_string(line) + ": " + std::string(why)};
}

Result<CurveDescription> readCurveLines(std::string_view text) {
    CurveDescription curve;
    std::string_view rest = text;
    for (std::size_t number = 1; !rest.empty(); ++number) {
        const std::string_view whole = takeLine(rest);
        const std::string_view line = trimmed(whole.substr(0, whole.find('#')));
        if (line.empty())
            continue;
        const std::string why =
            isDirective(line) ? takeDirective(line, curve) : takePoint(line, curve);
        if (!why.empty())
            return errorInLine(number, why);
    }
    return curve;
}

} // namespace quarn
