#pragma once

#include "tests/locale/Tables.h"

#include <string>
#include <vector>

namespace locale_rules {

/// A text and its translation, both in UTF-8.
struct Translation {
    std::string language;
    Space space = Space::strings;
    std::string english;
    std::string local;
};

/// What keeps a translation from being used: other format codes than the English text's, another
/// line break or blank at an end, blanks or signs in the name of an option.
/// @return what is wrong, in words; empty where nothing is
std::vector<std::string> faultsOfForm(const Translation& text);

/// The format codes of a text in their order: "%s", "%.2f", "%1"; "%%" is none.
std::vector<std::string> formatCodes(const std::string& text);

} // namespace locale_rules
