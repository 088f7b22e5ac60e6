#pragma once

/// Shows a message at the command line and hands on how the command ends.
/// @param text   in English
/// @param id     number of the text in the string tables
/// @param ended  a command's result
/// @return `ended`
int EndWith(const wchar_t* text, int id, int ended);
