#include "quarn/words/Words.h"

#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>

namespace quarn::program {

namespace {

template <class Number> std::optional<Number> wholeWord(std::string_view word) {
    if (word.starts_with('+'))
        word.remove_prefix(1);
    Number number{};
    const char* const end = word.data() + word.size();
    const auto [stop, error] = std::from_chars(word.data(), end, number);
    if (error != std::errc() || stop != end)
        return std::nullopt;
    return number;
}

} // namespace

std::optional<int> wholeNumber(std::string_view word) {
    return wholeWord<int>(word);
}

std::optional<double> realNumber(std::string_view word) {
    const std::optional<double> number = wholeWord<double>(word);
    return number && std::isfinite(*number) ? number : std::nullopt;
}

std::optional<Triple> triple(std::string_view word) {
    Triple point;
    for (std::size_t i = 0; i < point.size(); ++i) {
        const std::size_t comma = word.find(',');
        const bool is_last = i + 1 == point.size();
        if (is_last != (comma == std::string_view::npos))
            return std::nullopt;
        const std::optional<double> coordinate = realNumber(word.substr(0, comma));
        if (!coordinate)
            return std::nullopt;
        point[i] = *coordinate;
        if (!is_last)
            word.remove_prefix(comma + 1);
    }
    return point;
}

std::optional<PixelSize> pixelSize(std::string_view word) {
    const std::size_t cross = word.find_first_of("xX");
    if (cross == std::string_view::npos)
        return std::nullopt;
    const std::optional<int> width = wholeNumber(word.substr(0, cross));
    const std::optional<int> height = wholeNumber(word.substr(cross + 1));
    if (!width || !height)
        return std::nullopt;
    return PixelSize{*width, *height};
}

std::string numberText(double value) {
    std::array<char, 32> text;
    const double no_negative_zero = value == 0.0 ? 0.0 : value;
    const auto [end, error] =
        std::to_chars(text.data(), text.data() + text.size(), no_negative_zero);
    return error == std::errc() ? std::string(text.data(), end) : std::string();
}

std::string tripleText(const Triple& point) {
    return numberText(point[0]) + "," + numberText(point[1]) + "," + numberText(point[2]);
}

std::string lowerCase(std::string_view ascii) {
    std::string lower(ascii);
    std::transform(lower.begin(), lower.end(), lower.begin(),
                   [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; });
    return lower;
}

std::string utf8Text(std::wstring_view text) {
    return KM_wString(text).ToUtf8();
}

std::wstring wideText(std::string_view utf8) {
    return std::wstring(KM_wString::FromUtf8(utf8).View());
}

bool isUtf8(std::string_view bytes) {
    return utf8Text(wideText(bytes)) == bytes;
}

bool hasControlCharacter(std::string_view text) {
    return std::any_of(text.begin(), text.end(),
                       [](char c) { return static_cast<unsigned char>(c) < 32 || c == 127; });
}

std::optional<std::string> whyPathIsRefused(std::string_view subject,
                                            const std::filesystem::path& path) {
    const std::string start(subject);
    const std::string& bytes = path.native();
    if (bytes.empty())
        return start + " is empty.";
    if (bytes.find('"') != std::string::npos)
        return start + " holds a double quote, which no script can hold; rename it: " + bytes;
    if (hasControlCharacter(bytes))
        return start + " holds a line break or another control character; rename it.";
    if (!isUtf8(bytes))
        return start + " is no text in UTF-8; rename it.";
    return std::nullopt;
}

bool isDocument(const std::filesystem::path& file) {
    return lowerCase(file.extension().native()) == ".quarn";
}

std::string readingLine(const std::filesystem::path& model, const std::string& up,
                        double tolerance) {
    if (isDocument(model))
        return "_-Open " + quotedPath(model);
    const std::string axis = up.empty() ? "" : up == "y" ? "[Up] _Y " : "[Up] _Z ";
    const std::string nearness =
        tolerance > 0.0 ? "[Tolerance] " + numberText(tolerance) + " " : "";
    return "_-Import " + axis + nearness + quotedPath(model);
}

namespace {

/// As bash reads $'...': the only quotes that can hold a line break without breaking the line.
std::string numberedWord(const std::string& text) {
    std::string word = "$'";
    for (const char c : text) {
        char number[8];
        std::snprintf(number, sizeof number, "\\x%02x", static_cast<unsigned char>(c));
        word += number;
    }
    return word + "'";
}

} // namespace

std::string shellWord(const std::string& text) {
    constexpr std::string_view PLAIN = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
                                       "0123456789_-+=.,:/@%";
    if (!text.empty() && text.find_first_not_of(PLAIN) == std::string::npos)
        return text;
    if (hasControlCharacter(text))
        return numberedWord(text);
    std::string quoted = "'";
    for (const char c : text)
        quoted += c == '\'' ? "'\\''" : std::string(1, c);
    return quoted + "'";
}

std::string shellCommand(const std::vector<std::string>& words) {
    std::string command;
    for (const std::string& word : words)
        command += (command.empty() ? "" : " ") + shellWord(word);
    return command;
}

std::string quotedPath(const std::filesystem::path& path) {
    return '"' + path.native() + '"';
}

} // namespace quarn::program
