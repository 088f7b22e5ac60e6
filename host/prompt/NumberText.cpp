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
    char text[64];
    const auto [end, error] = std::to_chars(text, text + sizeof text, number);
    return KM_wString::FromUtf8({text, static_cast<std::size_t>(end - text)});
}

} // namespace quarn
