#include "host/commands/ColorText.h"

#include "sdk/qncore/QnLocalize.h"

#include <charconv>
#include <string>

namespace quarn {

namespace {

constexpr struct {
    std::string_view name;
    KM_Color color;
} NAMED[] = {{"black", {0, 0, 0, 255}},
             {"grey", {128, 128, 128, 255}},
             {"gray", {128, 128, 128, 255}},
             {"white", {255, 255, 255, 255}}};

std::string lowerCase(std::wstring_view text) {
    KM_wString lower(text);
    lower.TrimLeftAndRight();
    lower.MakeLower();
    return lower.ToUtf8();
}

std::uint8_t channel(unsigned rgb, int shift) {
    return static_cast<std::uint8_t>(rgb >> shift & 0xFFU);
}

} // namespace

std::optional<KM_Color> colorFromText(std::wstring_view text) {
    constexpr std::size_t DIGITS = 6;
    const std::string word = lowerCase(text);
    for (const auto& [name, color] : NAMED)
        if (word == name)
            return color;
    const std::string_view digits = std::string_view(word).substr(word.starts_with('#') ? 1 : 0);
    unsigned rgb = 0;
    const char* const end = digits.data() + digits.size();
    if (digits.size() != DIGITS || std::from_chars(digits.data(), end, rgb, 16).ptr != end)
        return std::nullopt;
    return KM_Color{channel(rgb, 16), channel(rgb, 8), channel(rgb, 0), 255};
}

KM_wString noColorText(const wchar_t* text) {
    return KM_wString::FormatToString(
        QnLocalizeString(L"\"%s\" is no colour. Give one such as #ff8800, or black, grey or white.",
                         42922),
        text);
}

KM_wString colorText(const KM_Color& color) {
    return KM_wString::FormatToString(L"#%02x%02x%02x", color.r, color.g, color.b);
}

} // namespace quarn
