#pragma once

#include "tests/locale/Tables.h"

#include <string>

namespace locale_rules {

/// Where a reader of a failed test finds the file: from the root of the sources.
inline std::string placeOf(const std::filesystem::path& file) {
    return file.lexically_relative(QUARN_SOURCE_DIR).string();
}

inline std::string placeOf(const TextUse& use) {
    return placeOf(use.file) + ":" + std::to_string(use.line);
}

inline std::string placeOf(const Table& table, const TextKey& key) {
    return placeOf(table.file) + " " + nameOf(key.first) + " " + std::to_string(key.second);
}

/// Calls `check(module, table, key, text)` for every text of every table.
template <class Check> void forEveryText(const Check& check) {
    for (const Module& module : modules())
        for (const Table& table : module.tables)
            for (const auto& [key, text] : table.texts)
                check(module, table, key, text);
}

} // namespace locale_rules
