#include "tests/locale/TextRules.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace locale_rules {
namespace {

std::string placeOf(const std::filesystem::path& file) {
    return file.lexically_relative(QUARN_SOURCE_DIR).string();
}

std::string placeOf(const TextUse& use) {
    return placeOf(use.file) + ":" + std::to_string(use.line);
}

std::string placeOf(const Table& table, const TextKey& key) {
    return placeOf(table.file) + " " + nameOf(key.first) + " " + std::to_string(key.second);
}

/// Calls `check(module, table, key, text)` for every text of every table.
template <class Check> void forEveryText(const Check& check) {
    std::size_t checked = 0;
    for (const Module& module : modules())
        for (const Table& table : module.tables)
            for (const auto& [key, text] : table.texts) {
                check(module, table, key, text);
                ++checked;
            }
    EXPECT_GT(checked, 1000U);
}

/// Calls `check(table, translation, key)` for every text whose English one the sources show.
template <class Check> void forEveryTranslation(const Check& check) {
    forEveryText(
        [&](const Module& module, const Table& table, const TextKey& key, const std::string& text) {
            for (const std::string& english : module.englishOf(key))
                check(table, Translation{table.language, key.first, english, text}, key);
        });
}

TEST(AllTables, AreThereForTheHostTheAnimationPlugInAndTheirWindows) {
    std::set<std::string> names;
    for (const Module& module : modules())
        names.insert(module.folder.filename());
    for (const char* name : {"host", "zoetrix"})
        EXPECT_TRUE(names.contains(name)) << name;
}

TEST(AllTables, AreFilesOfOrderedNumbersInEveryLanguage) {
    for (const Module& module : modules()) {
        for (const Table& table : module.tables)
            for (const std::string& fault : table.faults)
                ADD_FAILURE() << placeOf(table.file) << ": " << fault;
        for (const auto& entry : std::filesystem::directory_iterator(module.folder / "locale"))
            EXPECT_TRUE(std::ranges::any_of(
                module.tables, [&](const Table& table) { return table.file == entry.path(); }))
                << placeOf(entry.path()) << " is of no language that these rules know";
    }
}

TEST(AllTables, HoldEveryTextThatTheSourcesUse) {
    for (const Module& module : modules()) {
        EXPECT_FALSE(module.uses.empty()) << module.folder;
        for (const TextUse& use : module.uses)
            for (const Table& table : module.tables) {
                const auto has = [&](Space space) {
                    return table.texts.contains({space, use.number});
                };
                const bool is_there = use.space ? has(*use.space)
                                                : has(Space::strings) || has(Space::option_names) ||
                                                      has(Space::option_values);
                EXPECT_TRUE(is_there)
                    << placeOf(table.file) << " lacks " << (use.space ? nameOf(*use.space) : "text")
                    << " " << use.number << " of " << placeOf(use);
            }
    }
}

TEST(AllTables, HoldNoTextThatNoSourceUses) {
    forEveryText(
        [](const Module& module, const Table& table, const TextKey& key, const std::string&) {
            EXPECT_TRUE(std::ranges::any_of(module.uses,
                                            [&](const TextUse& use) {
                                                return use.number == key.second &&
                                                       use.space.value_or(key.first) == key.first;
                                            }))
                << placeOf(table, key) << " is used by no source";
        });
}

TEST(AllTables, HaveTheEnglishTextOfEveryNumberBesideIt) {
    for (const Module& module : modules())
        for (const TextUse& use : module.uses)
            EXPECT_TRUE(use.english)
                << placeOf(use) << " gives " << use.number
                << " to a text that is neither beside it nor a constant of the file";
}

TEST(AllTables, GiveANumberToOneTextOnly) {
    forEveryText(
        [](const Module& module, const Table& table, const TextKey& key, const std::string&) {
            EXPECT_LE(module.englishOf(key).size(), 1U)
                << placeOf(table, key) << " stands for \"" << module.englishOf(key).front()
                << "\" and \"" << module.englishOf(key).back() << "\"";
        });
}

/// Where several tables have a number, the one that was loaded first is asked.
TEST(AllTables, HaveTheSameTextWhereTwoHaveTheSameNumber) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        std::map<TextKey, std::string> seen;
        for (const Module& module : modules())
            for (const auto& [key, text] : module.tables[language].texts) {
                const auto place = seen.try_emplace(key, text).first;
                EXPECT_EQ(place->second, text) << placeOf(module.tables[language], key);
            }
    }
}

TEST(AllTables, KeepTheFormOfTheEnglishTexts) {
    forEveryTranslation([](const Table& table, const Translation& text, const TextKey& key) {
        for (const std::string& fault : faultsOfForm(text))
            ADD_FAILURE() << placeOf(table, key) << ": " << fault << ": \"" << text.local << "\"";
    });
}

TEST(AllTables, AreWrittenAsTheirLanguagesAre) {
    forEveryTranslation([](const Table& table, const Translation& text, const TextKey& key) {
        for (const std::string& fault : faultsOfWriting(text))
            ADD_FAILURE() << placeOf(table, key) << ": " << fault << ": \"" << text.local << "\"";
    });
}

} // namespace
} // namespace locale_rules
