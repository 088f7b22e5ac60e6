#pragma once

namespace kelmar {

/// One character to one, as Unicode has it, whatever the locale of the program is.
wchar_t toLower(wchar_t character);
wchar_t toUpper(wchar_t character);

/// The character that stands for all its case forms: the small letter of its capital, which letters
/// such as the Greek sigmas have in common.
wchar_t foldCase(wchar_t character);

/// White space of Unicode (property White_Space).
bool isSpace(wchar_t character);

} // namespace kelmar
