#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace layers {

/// One `#include` line of a source file.
struct Include {
    int line = 0;        ///< counted from 1
    bool quoted = false; ///< `"..."` rather than `<...>`
    std::string path;    ///< what stands between the marks
};

/// Reads the include lines of one source text, in their order. Lines that are commented out with
/// `//` are not includes.
std::vector<Include> includesOf(const std::string& source);

/// Says whether a file may have an include.
///
/// @param file     the including file, relative to the project root, with `/` as separator
/// @param include  one of its includes
/// @return true where the floors (Floors.h) allow it; a quoted path must be
///         relative to the project root
bool isAllowed(const std::string& file, const Include& include);

/// Checks all sources (.h, .cpp, .mm) of the folders that the rules know.
///
/// @param root  the project root, or a sample tree with the same folders
/// @return one line per breach, `file:line: may not include path`, sorted
std::vector<std::string> breachesBelow(const std::filesystem::path& root);

} // namespace layers
