#pragma once

#include "ground/Result.h"

#include <array>
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

/// The texts of one table: for each TextSpace in its order, number to text.
using TextTable = std::array<std::map<int, std::wstring>, 3>;

/// Reads the text of a table file, which StringTables describes.
/// @return an error, part of a sentence, when it is no string table
Result<TextTable> readTextTable(std::string_view json);

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
        std::array<Texts, std::tuple_size_v<TextTable>> texts;
    };

    std::vector<std::string> m_languages;
    std::vector<Table> m_tables;
};

} // namespace quarn
