#include "tests/zoetrix/PlugInFixture.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <map>
#include <regex>
#include <set>

namespace {

const std::filesystem::path source_folder = QUARN_SOURCE_DIR;
const char* const languages[] = {"de", "es", "fr", "ja", "zh"};

/// The tables of a language: part, number, text.
nlohmann::json tableOf(const std::filesystem::path& folder, const std::string& language) {
    return nlohmann::json::parse(readFile(folder / (language + ".json")));
}

nlohmann::json tableOf(const std::string& language) {
    return tableOf(source_folder / "zoetrix" / "locale", language);
}

/// But those of the sun, which hold no texts and the long numbers of formulas.
bool holdsTexts(const std::filesystem::path& file) {
    return (file.extension() == ".cpp" && file.parent_path().filename() != "sun") ||
           file.parent_path().filename() == "dialogs";
}

std::string allSources() {
    std::string text;
    for (const auto& entry :
         std::filesystem::recursive_directory_iterator(source_folder / "zoetrix"))
        if (holdsTexts(entry.path()))
            text += readFile(entry.path());
    return text;
}

std::vector<std::smatch> matches(const std::string& text, const std::regex& pattern) {
    return {std::sregex_iterator(text.begin(), text.end(), pattern), std::sregex_iterator()};
}

/// The numbers of texts that the sources use: they have five digits, and nothing else there has.
std::set<std::string> numbersInSources() {
    const std::string sources = allSources();
    std::set<std::string> numbers;
    for (const std::smatch& match : matches(sources, std::regex("\\b[1-4][0-9]{4}\\b")))
        numbers.insert(match.str());
    return numbers;
}

/// What a piece of source between quotes stands for.
std::string unescaped(const std::string& source) {
    std::string text;
    for (std::size_t i = 0; i < source.size(); ++i) {
        const bool escaped = source[i] == '\\' && i + 1 < source.size();
        if (escaped)
            ++i;
        text += escaped && source[i] == 'n' ? '\n' : source[i];
    }
    return text;
}

/// English texts by their numbers, where the dialogs' templates have them side by side.
std::map<std::string, std::string> textsOfTemplates() {
    const std::regex text_and_number("\"text\": \"([^\"]*)\", \"id\": ([1-4][0-9]{4})");
    std::map<std::string, std::string> texts;
    for (const auto& entry :
         std::filesystem::directory_iterator(source_folder / "zoetrix" / "dialogs")) {
        const std::string form = readFile(entry.path());
        for (const std::smatch& match : matches(form, text_and_number)) {
            const auto [place, is_new] = texts.try_emplace(match[2], match[1]);
            EXPECT_EQ(place->second, match[1]) << entry.path() << " " << match[2];
        }
    }
    return texts;
}

/// English texts by their numbers, where the sources have them side by side.
std::map<std::string, std::string> englishTexts() {
    const std::string sources = allSources();
    const std::regex literals_and_number(
        "((?:L\"(?:[^\"\\\\]|\\\\.)*\"\\s*)+),\\s*([1-4][0-9]{4})");
    const std::regex literal("L\"((?:[^\"\\\\]|\\\\.)*)\"");
    std::map<std::string, std::string> texts;
    for (const std::smatch& match : matches(sources, literals_and_number)) {
        const std::string literals = match[1];
        std::string text;
        for (const std::smatch& part : matches(literals, literal))
            text += unescaped(part[1]);
        texts[match[2]] = text;
    }
    return texts;
}

std::map<std::string, std::string> allTexts(const nlohmann::json& table) {
    std::map<std::string, std::string> texts;
    for (const auto& part : table.items())
        for (const auto& entry : part.value().items())
            texts[entry.key()] = entry.value().get<std::string>();
    return texts;
}

std::vector<std::string> directives(const std::string& text) {
    std::vector<std::string> found;
    for (const std::smatch& match : matches(text, std::regex("%.")))
        found.push_back(match.str());
    return found;
}

/// As names are compared: without blanks, dashes, underscores and commas.
std::string cleaned(std::string name) {
    std::erase_if(name, [](char c) { return c == '_' || c == ' ' || c == '-' || c == ','; });
    return name;
}

} // namespace

TEST(StringTables, HoldExactlyTheNumbersThatTheSourcesUse) {
    const std::set<std::string> used = numbersInSources();
    EXPECT_GT(used.size(), 70U);
    for (const char* language : languages) {
        std::set<std::string> listed;
        for (const auto& [number, text] : allTexts(tableOf(language))) {
            EXPECT_FALSE(text.empty()) << language << " " << number;
            listed.insert(number);
        }
        EXPECT_EQ(used, listed) << language;
    }
}

TEST(StringTables, NoNumberStandsForTwoTexts) {
    const std::string sources = allSources();
    std::map<std::string, std::string> seen;
    const std::regex literal_and_number("L\"((?:[^\"\\\\]|\\\\.)*)\",\\s*([1-4][0-9]{4})");
    for (const std::smatch& match : matches(sources, literal_and_number)) {
        const auto [place, is_new] = seen.try_emplace(match[2], match[1]);
        EXPECT_EQ(place->second, match[1]) << match[2];
    }
    EXPECT_GT(seen.size(), 60U);
}

TEST(StringTables, TemplatesAndSourcesSayTheSameByTheSameNumber) {
    const std::map<std::string, std::string> in_sources = englishTexts();
    const std::map<std::string, std::string> in_templates = textsOfTemplates();
    EXPECT_EQ("Set Location...", in_templates.at("40511"));
    EXPECT_EQ(in_sources.at("40005"), in_templates.at("40005"));
    for (const auto& [number, text] : in_templates)
        if (in_sources.contains(number)) {
            EXPECT_EQ(in_sources.at(number), text) << number;
        }
}

TEST(StringTables, KeepFormatDirectivesAndTheEndOfTheLine) {
    const std::map<std::string, std::string> english = englishTexts();
    ASSERT_EQ("Vex UI (ZEL_VexUI.qnp) cannot be loaded.", english.at("40001"));
    ASSERT_EQ(2U, directives(english.at("40012")).size());
    for (const char* language : languages) {
        for (const auto& [number, text] : allTexts(tableOf(language))) {
            const auto found = english.find(number);
            if (found == english.end())
                continue; // It shares its text with another number.
            EXPECT_EQ(directives(found->second), directives(text)) << language << " " << number;
            EXPECT_EQ(found->second.ends_with("\n"), text.ends_with("\n"))
                << language << " " << number;
            EXPECT_EQ(found->second.ends_with(" "), text.ends_with(" "))
                << language << " " << number;
        }
    }
}

TEST(StringTables, TextsThatAreComparedAgree) {
    for (const char* language : languages) {
        const nlohmann::json strings = tableOf(language)["strings"];
        for (const char* number : {"19748", "20762"})
            EXPECT_EQ(strings["19750"], strings[number]) << language << " " << number;
        for (const char* number : {"19749", "20763"})
            EXPECT_EQ(strings["19751"], strings[number]) << language << " " << number;
        const std::set<std::string> names = {strings["19750"], strings["19751"], strings["19747"],
                                             strings["20121"], strings["32015"]};
        EXPECT_EQ(5U, names.size()) << language;
        EXPECT_NE(cleaned(strings["19746"]), cleaned(strings["20120"])) << language;
        EXPECT_NE(cleaned(strings["19746"]), cleaned(strings["32015"])) << language;
    }
}

TEST(StringTables, NamesOfModesAreThoseOfTheHost) {
    const std::filesystem::path host_tables = source_folder / "host" / "locale";
    for (const char* language : languages) {
        const nlohmann::json ours = tableOf(language)["strings"];
        const nlohmann::json hosts = tableOf(host_tables, language)["strings"];
        for (const char* number : {"32015", "19746", "20120"})
            EXPECT_EQ(hosts[number], ours[number]) << language << " " << number;
    }
}

TEST(StringTables, NamesThatOptionsAreMadeOfHaveNoBlanks) {
    for (const char* language : languages) {
        const nlohmann::json table = tableOf(language);
        for (const auto& entry : table["option_names"].items())
            EXPECT_EQ(std::string::npos, entry.value().get<std::string>().find(' '))
                << language << " " << entry.key();
        for (const char* number : {"19747", "19748", "19749", "20121"})
            EXPECT_EQ(std::string::npos,
                      table["strings"][number].get<std::string>().find_first_of(" _-,"))
                << language << " " << number;
    }
}
