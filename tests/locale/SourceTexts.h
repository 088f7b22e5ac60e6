#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace locale_rules {

/// The spaces of numbers that a string table has.
enum class Space { strings, option_names, option_values };

/// A place in the sources that gives a text a number.
struct TextUse {
    int number = 0;
    /// What the number is looked up as; nothing where it only stands in a table of the sources.
    std::optional<Space> space;
    /// In UTF-8; nothing where it is neither written beside the number nor a constant of the file.
    std::optional<std::string> english;
    std::filesystem::path file;
    int line = 0; ///< from 1
};

/// Every numbered text of a C++ source: `L"Text", 12345`, or `constant, 12345` where the constant
/// is a text of the same file, and whatever else is given to one of the interface's look-ups.
/// Numbers of texts have five digits.
std::vector<TextUse> textUses(std::string_view source, const std::filesystem::path& file);

/// Those of all sources (.cpp, .h, .mm) and dialog templates below a folder.
std::vector<TextUse> textUsesBelow(const std::filesystem::path& folder);

} // namespace locale_rules
