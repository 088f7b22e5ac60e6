#pragma once

#include "ground/Result.h"

#include <filesystem>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// The kinds of texts; each has numbers of its own.
enum class TextSpace { strings, option_names, option_values };

/// The languages in which tables are looked for, the best first: "de_AT.UTF-8" gives "de_AT" and
/// "de", "zh-Hans-CN" gives "zh-Hans-CN", "zh-Hans" and "zh". An empty text takes the language from
/// LC_ALL, LC_MESSAGES or LANG, the first that is set. "C" and "POSIX", and what is no language
/// name, give none.
std::vector<std::string> wantedLanguages(std::string_view language);

/// The texts of the user's language: one table for the host and one for each plug-in.
///
/// A table is a JSON file `<language>.json`:
/// `{"strings": {"16714": "Dateityp"}, "option_names": {...}, "option_values": {...}}`, where every
/// part may be left out.
class StringTables {
public:
    /// @param language  as wantedLanguages takes it
    explicit StringTables(std::string_view language);

    /// Adds the table of the best wanted language found in the first of these folders that has
    /// one. No table at all is no fault.
    /// @param owner  whose table it is; it replaces the owner's former one
    /// @return an error, and no table, when the file is no string table
    Result<void> load(const std::string& owner, const std::vector<std::filesystem::path>& folders);
    void remove(const std::string& owner);

    /// The text with this number, which stays valid until the program ends; null when no table has
    /// it. Where several tables do, the one loaded first is right.
    const wchar_t* find(TextSpace space, int id) const;

private:
    using Texts = std::map<int, const wchar_t*>;
    struct Table {
        std::string owner;
        Texts texts[3];
    };
    Result<Table> read(const std::filesystem::path& file) const;

    std::vector<std::string> m_languages;
    std::vector<Table> m_tables;
};

} // namespace quarn
