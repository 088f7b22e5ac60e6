#include "host/prompt/NumberText.h"

#include <charconv>
#include <cmath>
#include <string>

namespace quarn {

namespace {

/// The text without blanks around it and without a leading plus, in bytes.
std::string plainText(std::wstring_view text) {
    KM_wString trimmed(text);
    trimmed.TrimLeftAndRight();
    std::string bytes = trimmed.ToUtf8();
    if (bytes.size() > 1 && bytes[0] == '+' && bytes[1] != '-')
        bytes.erase(0, 1);
    return bytes;
}

template <class Number> std::optional<Number> readWhole(const std::string& bytes) {
    Number number{};
    const char* end = bytes.data() + bytes.size();
    const auto [stop, error] = std::from_chars(bytes.data(), end, number);
    if (error != std::errc() || stop != end)
        return std::nullopt;
    return number;
}

} // namespace

std::optional<double> readNumber(std::wstring_view text) {
    const std::optional<double> number = readWhole<double>(plainText(text));
    return number && std::isfinite(*number) ? number : std::nullopt;
}

std::optional<int> readWholeNumber(std::wstring_view text) {
    return readWhole<int>(plainText(text));
}

KM_wString numberText(double number) {
    const double size = std::abs(number);
    const bool is_plain = size == 0.0 || (size >= 1e-5 && size < 1e15);
    char text[64];
    char* const limit = text + sizeof text;
    const auto [end, error] = is_plain
                                  ? std::to_chars(text, limit, number, std::chars_format::fixed)
                                  : std::to_chars(text, limit, number);
    return KM_wString::FromUtf8({text, static_cast<std::size_t>(end - text)});
}

} // namespace quarn
