#include "quarn/terminal/ShownText.h"

#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

/// The control characters of ASCII and those of Latin-1, which terminals obey too.
bool isControl(wchar_t c) {
    return (c < 0x20 && c != L'\n' && c != L'\t') || (c >= 0x7F && c < 0xA0);
}

} // namespace

std::wstring shownText(std::wstring_view text) {
    constexpr std::wstring_view DIGITS = L"0123456789ABCDEF";
    std::wstring shown;
    for (const wchar_t c : text) {
        if (isControl(c))
            shown.append(L"\\x").append({DIGITS[c / 16], DIGITS[c % 16]});
        else
            shown += c;
    }
    return shown;
}

std::string shownText(std::string_view utf8) {
    return utf8Text(shownText(wideText(utf8)));
}

} // namespace quarn::program
