#include "host/curves/CurveFile.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/curves/CurveDescription.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::uintmax_t LARGEST_FILE = 64ULL << 20;

std::string_view withoutByteOrderMark(std::string_view text) {
    return text.starts_with("\xEF\xBB\xBF") ? text.substr(3) : text;
}

CurveResult curveOf(const CurveDescription& description) {
    const bool is_rational =
        std::ranges::any_of(description.weights, [](double w) { return w != 1.0; });
    if (description.degree == 1 && !is_rational)
        return makePolyline(description.points, description.closed);
    const std::span<const double> weights =
        is_rational ? std::span(description.weights) : std::span<const double>();
    return makeSpline(description.points, description.degree, description.closed, weights);
}

Result<void> checkSize(const std::filesystem::path& file) {
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(file, error);
    if (!error && size > LARGEST_FILE)
        return Error{"it is larger than 64 MB"};
    return {};
}

} // namespace

CurveResult readCurveText(std::string_view text) {
    const std::string_view content = withoutByteOrderMark(text);
    const std::size_t first = content.find_first_not_of(" \t\r\n");
    const bool is_json = first != content.npos && content[first] == '{';
    const auto description = is_json ? readCurveJson(content) : readCurveLines(content);
    if (!description)
        return description.error();
    if (description.value().points.empty())
        return Error{"there are no points in it"};
    return curveOf(description.value());
}

CurveResult readCurveFile(const std::filesystem::path& file) {
    const std::string name = textFromPath(file).ToUtf8();
    const Result<void> sized = checkSize(file);
    if (!sized)
        return Error{"Cannot read '" + name + "': " + sized.message() + "."};
    const auto read = readFileBytes(file);
    if (!read)
        return Error{"Cannot read '" + name + "': " + read.message() + "."};
    const std::span<const std::uint8_t> bytes = read.value().bytes();
    CurveResult curve = readCurveText({reinterpret_cast<const char*>(bytes.data()), bytes.size()});
    if (curve)
        return curve;
    const std::string& why = curve.message();
    return Error{"Cannot read a curve from '" + name + "': " + why +
                 (why.ends_with('.') ? "" : ".")};
}

} // namespace quarn
