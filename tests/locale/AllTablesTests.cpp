#include "tests/locale/Places.h"
#include "tests/locale/TextRules.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace locale_rules {
namespace {

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
    for (const char* name : {"desktop", "host", "vexui", "zoetrix"})
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
                if (!is_there)
                    ADD_FAILURE() << placeOf(table.file) << " lacks "
                                  << (use.space ? nameOf(*use.space) : "text") << " " << use.number
                                  << " of " << placeOf(use);
            }
    }
}

TEST(AllTables, HoldNoTextThatNoSourceUses) {
    forEveryText(
        [](const Module& module, const Table& table, const TextKey& key, const std::string&) {
            const bool is_used = std::ranges::any_of(module.uses, [&](const TextUse& use) {
                return use.number == key.second && use.space.value_or(key.first) == key.first;
            });
            if (!is_used)
                ADD_FAILURE() << placeOf(table, key) << " is used by no source";
        });
}

TEST(AllTables, HaveTheEnglishTextOfEveryNumberBesideIt) {
    for (const Module& module : modules())
        for (const TextUse& use : module.uses)
            if (!use.english)
                ADD_FAILURE() << placeOf(use) << " gives " << use.number
                              << " to a text that is neither beside it nor a constant of the file";
}

TEST(AllTables, GiveANumberToOneTextOnly) {
    forEveryText(
        [](const Module& module, const Table& table, const TextKey& key, const std::string&) {
            const std::vector<std::string> texts = module.englishOf(key);
            if (texts.size() > 1)
                ADD_FAILURE() << placeOf(table, key) << " stands for \"" << texts.front()
                              << "\" and \"" << texts.back() << "\"";
        });
}

/// Where several tables have a number, the one that was loaded first is asked.
TEST(AllTables, HaveTheSameTextWhereTwoHaveTheSameNumber) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        std::map<TextKey, std::string> seen;
        for (const Module& module : modules())
            for (const auto& [key, text] : module.tables[language].texts) {
                const auto place = seen.try_emplace(key, text).first;
                if (place->second != text)
                    ADD_FAILURE() << placeOf(module.tables[language], key) << " is \"" << text
                                  << "\" but elsewhere \"" << place->second << "\"";
            }
    }
}

TEST(AllTables, KeepTheFormOfTheEnglishTexts) {
    forEveryTranslation([](const Table& table, const Translation& text, const TextKey& key) {
        for (const std::string& fault : faultsOfForm(text))
            ADD_FAILURE() << placeOf(table, key) << ": " << fault << ": \"" << text.local << "\"";
    });
}

} // namespace
} // namespace locale_rules
