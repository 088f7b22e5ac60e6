#pragma once

namespace kelmar {

/// One character to one, by tables of our own: the C library's case changes follow the locale.
wchar_t toLower(wchar_t character);
wchar_t toUpper(wchar_t character);

/// The character that stands for all its case forms: lower case, and one form for the Greek final
/// sigma, the micro sign and the long s, which have capitals in common with other letters.
wchar_t foldCase(wchar_t character);

/// White space of Unicode (property White_Space).
bool isSpace(wchar_t character);

} // namespace kelmar
