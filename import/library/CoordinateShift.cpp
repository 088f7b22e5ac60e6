#include "import/library/CoordinateShift.h"

#include "import/files/ModelFileCheck.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <fstream>
#include <string_view>

namespace quarn {
namespace {

constexpr double far_coordinate = 10'000.0;
constexpr double origin_step = 1'000.0;

using Coordinates = std::array<double, 3>;

bool isBlank(char c) {
    return c == ' ' || c == '\t';
}

bool isVertex(std::string_view line) {
    return line.size() > 2 && line[0] == 'v' && isBlank(line[1]);
}

/// Reads the three numbers of a vertex line.
/// @return what follows them, or nothing when they cannot be understood
std::optional<std::string_view> readVertex(std::string_view line, Coordinates& place) {
    const char* at = line.data() + 1;
    const char* const end = line.data() + line.size();
    for (double& coordinate : place) {
        while (at != end && isBlank(*at)) {
            ++at;
        }
        at += at != end && *at == '+' ? 1 : 0;
        const auto [rest, failure] = std::from_chars(at, end, coordinate);
        if (failure != std::errc()) {
            return std::nullopt;
        }
        at = rest;
    }
    return std::string_view(at, static_cast<std::size_t>(end - at));
}

/// A fourth number divides the three; more than one are a colour.
bool hasWeight(std::string_view rest) {
    constexpr std::string_view blanks = " \t\r\n";
    const std::size_t begin = rest.find_first_not_of(blanks);
    if (begin == std::string_view::npos) {
        return false;
    }
    const std::size_t end = rest.find_first_of(blanks, begin);
    return end == std::string_view::npos ||
           rest.find_first_not_of(blanks, end) == std::string_view::npos;
}

/// The next line, with its line break; `text` loses it.
std::string_view takeLine(std::string_view& text) {
    const std::size_t line_break = text.find('\n');
    const std::size_t length = line_break == std::string_view::npos ? text.size() : line_break + 1;
    const std::string_view line = text.substr(0, length);
    text.remove_prefix(length);
    return line;
}

std::optional<Coordinates> originFor(std::ifstream& file) {
    std::string line;
    while (std::getline(file, line)) {
        if (!isVertex(line)) {
            continue;
        }
        Coordinates place{};
        const bool known = readVertex(line, place).has_value();
        const auto is_far = [](double c) {
            return std::isfinite(c) && std::abs(c) >= far_coordinate;
        };
        if (!known || std::none_of(place.begin(), place.end(), is_far)) {
            return std::nullopt;
        }
        for (double& c : place) {
            c = std::isfinite(c) ? origin_step * std::trunc(c / origin_step) : 0.0;
        }
        return place;
    }
    return std::nullopt;
}

bool appendShifted(std::string_view line, const Coordinates& origin, std::string& bytes) {
    Coordinates place{};
    const auto rest = readVertex(line, place);
    if (!rest || hasWeight(*rest)) {
        return false;
    }
    bytes += 'v';
    for (std::size_t i = 0; i < 3; ++i) {
        std::array<char, 32> digits{};
        const auto near = static_cast<float>(place[i] - origin[i]);
        const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), near);
        bytes += ' ';
        bytes.append(digits.data(), written.ptr);
    }
    bytes += *rest;
    return true;
}

std::string contentsOf(std::ifstream& file, const std::filesystem::path& path) {
    std::error_code failure;
    std::string text(std::filesystem::file_size(path, failure), '\0');
    file.clear();
    file.seekg(0);
    file.read(text.data(), static_cast<std::streamsize>(text.size()));
    text.resize(static_cast<std::size_t>(file.gcount()));
    return text;
}

} // namespace

std::optional<ShiftedFile> shiftFarCoordinates(const std::filesystem::path& path) {
    if (modelFormat(path) != "obj") {
        return std::nullopt;
    }
    std::ifstream file(path, std::ios::binary);
    const auto origin = originFor(file);
    if (!origin) {
        return std::nullopt;
    }
    const std::string text = contentsOf(file, path);
    ShiftedFile shifted{{(*origin)[0], (*origin)[1], (*origin)[2]}, {}};
    shifted.bytes.reserve(text.size());
    std::string_view rest(text);
    while (!rest.empty()) {
        const std::string_view line = takeLine(rest);
        if (!isVertex(line)) {
            shifted.bytes += line;
        } else if (!appendShifted(line, *origin, shifted.bytes)) {
            return std::nullopt;
        }
    }
    return shifted;
}

} // namespace quarn
