#include "host/app/StringTables.h"

#include "sdk/qncore/QnLocalize.h"
#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <fstream>

namespace quarn {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

std::filesystem::path folder(const std::string& name) {
    static const test::TempFolder folder_of_program;
    const std::filesystem::path path = folder_of_program / name;
    std::filesystem::create_directories(path);
    return path;
}

void writeTable(const std::filesystem::path& file, const std::string& json) {
    std::ofstream(file, std::ios::binary) << json;
}

TEST(StringTables, TheLanguageComesWithAndWithoutItsCountry) {
    EXPECT_THAT(wantedLanguages("de_AT.UTF-8@euro"), ElementsAre("de_AT", "de"));
    EXPECT_THAT(wantedLanguages("ja"), ElementsAre("ja"));
    EXPECT_THAT(wantedLanguages("C.UTF-8"), IsEmpty());
    EXPECT_THAT(wantedLanguages("POSIX"), IsEmpty());
    EXPECT_THAT(wantedLanguages("../../etc/passwd"), IsEmpty());
}

TEST(StringTables, AScriptBetweenLanguageAndCountryIsLeftOutStepByStep) {
    EXPECT_THAT(wantedLanguages("zh_Hans_CN.UTF-8"), ElementsAre("zh_Hans_CN", "zh_Hans", "zh"));
    EXPECT_THAT(wantedLanguages("zh-Hant-TW"), ElementsAre("zh-Hant-TW", "zh-Hant", "zh"));
    EXPECT_THAT(wantedLanguages("_-"), ElementsAre("_-", "_"));
}

/// Who reads the long form of Chinese characters reads the short one more easily than English.
TEST(StringTables, EveryNameOfChineseFindsTheOneChineseTable) {
    for (const char* name : {"zh_CN.UTF-8", "zh_SG", "zh-Hans", "zh_Hans_CN", "zh_TW.Big5", "zh_HK",
                             "zh-Hant", "zh@pinyin", "zh"}) {
        StringTables tables(name);
        ASSERT_TRUE(tables.load("host", {std::filesystem::path(QUARN_SOURCE_DIR) / "host/locale"}));
        EXPECT_STREQ(tables.find(TextSpace::option_names, 42002), L"目标") << name;
    }
}

TEST(StringTables, ALanguageWithoutATableIsEnglish) {
    StringTables tables("pt_BR.UTF-8");
    ASSERT_TRUE(tables.load("host", {std::filesystem::path(QUARN_SOURCE_DIR) / "host/locale"}));
    EXPECT_EQ(tables.find(TextSpace::option_names, 42002), nullptr);
}

TEST(StringTables, TheEnvironmentIsAskedInTheOrderAllMessagesLang) {
    setenv("LANG", "fr_FR.UTF-8", 1);
    unsetenv("LC_MESSAGES");
    unsetenv("LC_ALL");
    EXPECT_THAT(wantedLanguages(""), ElementsAre("fr_FR", "fr"));
    setenv("LC_MESSAGES", "ja_JP", 1);
    EXPECT_THAT(wantedLanguages(""), ElementsAre("ja_JP", "ja"));
    setenv("LC_ALL", "de", 1);
    EXPECT_THAT(wantedLanguages(""), ElementsAre("de"));
    setenv("LC_ALL", "", 1);
    EXPECT_THAT(wantedLanguages(""), ElementsAre("ja_JP", "ja"));
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"})
        unsetenv(variable);
}

TEST(StringTables, StringsOptionNamesAndOptionValuesAreSeparate) {
    const auto tables_folder = folder("spaces");
    writeTable(tables_folder / "de.json", R"({"strings": {"7": "Text"},
        "option_names": {"7": "Name"}, "option_values": {"7": "Größe"}})");
    StringTables tables("de_AT");
    ASSERT_TRUE(tables.load("host", {tables_folder}));
    EXPECT_STREQ(tables.find(TextSpace::strings, 7), L"Text");
    EXPECT_STREQ(tables.find(TextSpace::option_names, 7), L"Name");
    EXPECT_STREQ(tables.find(TextSpace::option_values, 7), L"Größe");
    EXPECT_EQ(tables.find(TextSpace::strings, 8), nullptr);
}

TEST(StringTables, TheCountrysOwnTableComesBeforeTheLanguages) {
    const auto first = folder("first");
    const auto second = folder("second");
    writeTable(first / "de.json", R"({"strings": {"7": "Sessel"}})");
    writeTable(second / "de_AT.json", R"({"strings": {"7": "Fauteuil"}})");
    StringTables tables("de_AT");
    ASSERT_TRUE(tables.load("host", {first, second}));
    EXPECT_STREQ(tables.find(TextSpace::strings, 7), L"Fauteuil");
}

TEST(StringTables, ATextOutlivesItsTable) {
    const auto tables_folder = folder("outlives");
    writeTable(tables_folder / "de.json", R"({"strings": {"7": "Bleibt"}})");
    StringTables tables("de");
    ASSERT_TRUE(tables.load("plug-in", {tables_folder}));
    const wchar_t* text = tables.find(TextSpace::strings, 7);
    tables.remove("plug-in");
    EXPECT_EQ(tables.find(TextSpace::strings, 7), nullptr);
    EXPECT_STREQ(text, L"Bleibt");
}

TEST(StringTables, AMalformedTableIsLeftOutWhole) {
    const auto tables_folder = folder("malformed");
    for (const char* json :
         {"", "{", "[]", R"({"strings": []})", R"({"strings": {"7": 5}})",
          R"({"strings": {"6": "good", "seven": "x"}})", R"({"strings": {"0": "x"}})",
          R"({"strings": {"-1": "x"}})", R"({"strings": {"99999999999": "x"}})", "\xFF\xFE"}) {
        writeTable(tables_folder / "de.json", json);
        StringTables tables("de");
        const Result<void> loaded = tables.load("host", {tables_folder});
        ASSERT_FALSE(loaded) << json;
        EXPECT_THAT(loaded.message(), HasSubstr("de.json"));
        EXPECT_EQ(tables.find(TextSpace::strings, 6), nullptr);
    }
}

TEST(StringTables, ATableLongerThanAnyLanguageIsLeftOut) {
    const auto tables_folder = folder("long");
    writeTable(tables_folder / "de.json", R"({"strings": {"7": "Sieben"}})");
    std::filesystem::resize_file(tables_folder / "de.json", (1 << 24) + 1);
    StringTables tables("de");
    const Result<void> loaded = tables.load("host", {tables_folder});
    ASSERT_FALSE(loaded);
    EXPECT_THAT(loaded.message(), HasSubstr("de.json was left out: it has more than 16777216"));
}

TEST(StringTables, NoTableAtAllIsNoFault) {
    StringTables tables("de");
    EXPECT_TRUE(tables.load("host", {folder("empty"), "no/such/folder"}));
}

// ---- The interface's calls

TEST(Localize, ATextIsLookedUpByItsNumberAndFallsBackToEnglish) {
    const auto tables_folder = folder("host_table");
    writeTable(tables_folder / "de.json", R"({"strings": {"7": "Sieben"},
        "option_names": {"7": "Name"}, "option_values": {"7": "Wert"}})");
    ScriptedFrontEnd front_end;
    Session session(front_end, {{}, {tables_folder}, "de", {}});
    const wchar_t* english = L"Seven";
    EXPECT_STREQ(QnLocalizeString(english, 7), L"Sieben");
    EXPECT_EQ(QnLocalizeString(english, 8), english);
    EXPECT_EQ(QnLocalizeString(english, 0), english);
    EXPECT_STREQ(QnLocalizeCommandOptionName(english, 7).m_english, L"Seven");
    EXPECT_STREQ(QnLocalizeCommandOptionName(english, 7).m_local, L"Name");
    EXPECT_STREQ(QnLocalizeCommandOptionValue(english, 7).m_local, L"Wert");
    EXPECT_STREQ(QnLocalizeCommandOptionValue(english, 0).m_local, L"Seven");
}

TEST(Localize, AMalformedHostTableIsToldAndTheHostStartsInEnglish) {
    const auto tables_folder = folder("bad_host_table");
    writeTable(tables_folder / "de.json", "{ not json");
    ScriptedFrontEnd front_end;
    Session session(front_end, {{}, {tables_folder}, "de", {}});
    EXPECT_THAT(KM_wString(front_end.printed()).ToUtf8(), HasSubstr("was left out"));
    EXPECT_STREQ(QnLocalizeString(L"Seven", 7), L"Seven");
}

} // namespace
} // namespace quarn
