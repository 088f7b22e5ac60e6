#pragma once

#include <string_view>

// What an animation may be called. Its folder, its pictures and its page are files of that name.

/// The characters that no file's name holds, because one system or another forbids them.
inline constexpr std::wstring_view QnForbiddenInNames = L"\\|/:*?\"<>";

/// Whether the character is one of them. A byte of UTF-8 may be asked for like a character.
constexpr bool QnIsForbiddenInNames(wchar_t character) {
    return QnForbiddenInNames.find(character) != std::wstring_view::npos;
}

/// Whether the character steers a terminal, a page or a script instead of being seen: the control
/// characters of ASCII and Latin-1, and the line and paragraph breaks of Unicode.
constexpr bool QnIsControlCharacter(wchar_t character) {
    return (character >= 0 && character < 0x20) || (character >= 0x7F && character < 0xA0) ||
           character == L'\u2028' || character == L'\u2029';
}

/// The longest name of an animation, in characters.
inline constexpr int QnLongestAnimationName = 255;
