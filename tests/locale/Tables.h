#pragma once

#include "tests/locale/SourceTexts.h"

#include <filesystem>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace locale_rules {

inline constexpr const char* LANGUAGES[] = {"de", "es", "fr", "ja", "zh"};

using TextKey = std::pair<Space, int>;

/// `strings`, `option_names` or `option_values`.
const char* nameOf(Space space);

/// One file of texts.
struct Table {
    std::filesystem::path file;
    std::string language;
    std::map<TextKey, std::string> texts; ///< in UTF-8
    /// What is wrong with the file as such: no JSON, a number twice, numbers out of order.
    std::vector<std::string> faults;
};

/// @param file  `<language>.json`
Table readTable(const std::filesystem::path& file);

/// A folder of sources with tables of its own.
struct Module {
    std::filesystem::path folder;
    std::vector<TextUse> uses;
    std::vector<Table> tables; ///< one for each of LANGUAGES

    /// The English texts of a number in one space, as far as the sources show them: those that are
    /// looked up there, else those that stand in a list of the sources.
    const std::vector<std::string>& englishOf(const TextKey& key) const;

    std::map<TextKey, std::vector<std::string>> looked_up;
    std::map<int, std::vector<std::string>> listed;
};

/// Every folder of the sources that has a folder `locale`.
const std::vector<Module>& modules();

} // namespace locale_rules
