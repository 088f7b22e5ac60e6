#include "import/text/WideText.h"

#include "kelmar/KM_wString.h"

#include <string>

namespace quarn {

namespace {

/// Joins the two halves of a character beyond 16 bits (Unicode 15.0, section 3.9, D91). A half
/// alone stays as it is, which is no character.
void appendUnit(std::wstring& text, wchar_t unit) {
    const bool is_low = unit >= 0xDC00 && unit < 0xE000;
    const bool is_second = is_low && !text.empty() && text.back() >= 0xD800 && text.back() < 0xDC00;
    if (is_second)
        text.back() = 0x10000 + ((text.back() - 0xD800) << 10) + (unit - 0xDC00);
    else
        text += unit;
}

} // namespace

std::optional<std::string> utf8OfWideText(std::span<const std::uint8_t> bytes) {
    const bool is_big = bytes.size() >= 2 && bytes[0] == 0xFE && bytes[1] == 0xFF;
    const bool is_little = bytes.size() >= 2 && bytes[0] == 0xFF && bytes[1] == 0xFE;
    if (!is_big && !is_little)
        return std::nullopt;
    std::wstring wide;
    for (std::size_t i = 2; i + 1 < bytes.size(); i += 2) {
        const int first = bytes[i];
        const int second = bytes[i + 1];
        appendUnit(wide, is_big ? first << 8 | second : second << 8 | first);
    }
    return KM_wString(wide).ToUtf8();
}

} // namespace quarn
