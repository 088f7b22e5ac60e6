#include "tests/locale/Places.h"

#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <regex>
#include <set>

namespace locale_rules {
namespace {

/// Texts that may be the same in every language: names, endings of files, and signs of units.
constexpr std::string_view NAMES[] = {"Zoetrix", "Vex UI", "Quarn", "jpg",    "bmp",
                                      "png",     "tga",    "OK",    "%1 min", "%1 h %2 min"};

/// Words that a language shares with English.
constexpr struct {
    std::string_view language;
    std::string_view word;
} COGNATES[] = {
    {"de", "Animation"}, {"de", "Name"},     {"de", "Radius"},     {"de", "Parallel"},
    {"de", "Version"},   {"de", "Ids"},      {"de", "Standard"},   {"de", "Text"},
    {"de", "Plug-ins"},  {"es", "No"},       {"es", "Ids"},        {"fr", "Animation"},
    {"fr", "Direction"}, {"fr", "Distance"}, {"fr", "Version"},    {"fr", "Ids"},
    {"fr", "Standard"},  {"fr", "Latitude"}, {"fr", "Longitude"},  {"fr", "Perspective"},
    {"fr", "Point"},     {"fr", "Date"},     {"fr", "Projection"}, {"ja", "Ids"},
};

/// English texts with more than one sense, which other languages have words of their own for.
constexpr std::string_view OF_SEVERAL_SENSES[] = {
    "None", // of objects and of edges, which have genders
    "All",
    "Render",                                   // the title of a menu, and to do it
    "Direction",                                // of a turn and of the sun
    "Invalid number of frames. Nothing done\n", // how many, and which one
};

/// What two texts have in common that differ as a menu, a label and the name of an option do.
std::string bare(std::string_view text) {
    static const std::regex at_the_end("\\(&[^)]\\)|(\u2026|: ?|\uff1a)$|[-& ]");
    KM_wString lower =
        KM_wString::FromUtf8(std::regex_replace(std::string(text), at_the_end, std::string()));
    lower.MakeLower();
    return lower.ToUtf8();
}

bool isName(const std::string& english) {
    return std::ranges::find(NAMES, english) != std::end(NAMES);
}

bool isCognate(const std::string& language, const std::string& english) {
    return std::ranges::any_of(COGNATES, [&](const auto& cognate) {
        return cognate.language == language && bare(cognate.word) == bare(english);
    });
}

bool hasSeveralSenses(const std::string& english) {
    return std::ranges::any_of(
        OF_SEVERAL_SENSES, [&](std::string_view listed) { return bare(listed) == bare(english); });
}

/// Whether a word is left to translate when format codes and access keys are taken away.
bool hasWords(const std::string& text) {
    static const std::regex code_or_key("%[-.0-9]*[a-zA-Z]?|&");
    static const std::regex word("[a-zA-Z]{2}");
    return std::regex_search(std::regex_replace(text, code_or_key, ""), word);
}

bool hasEastAsianCharacters(const std::string& text) {
    return std::ranges::any_of(KM_wString::FromUtf8(text).View(),
                               [](wchar_t c) { return c >= 0x3041 && c <= 0x9FFF; });
}

bool isOption(const TextUse& use, const Table& table) {
    return use.space.value_or(Space::option_names) == Space::option_names &&
           table.texts.contains({Space::option_names, use.number});
}

/// The local names of the options that a source has, by their English ones.
std::map<std::string, std::string> optionsOf(const std::filesystem::path& source,
                                             const Module& module, const Table& table) {
    std::map<std::string, std::string> options;
    for (const TextUse& use : module.uses)
        if (use.file == source && use.english && isOption(use, table))
            options[bare(*use.english)] = bare(table.texts.at({Space::option_names, use.number}));
    return options;
}

/// The English names of options that have a name in common.
std::vector<std::pair<std::string, std::string>>
confusedOptions(const std::map<std::string, std::string>& options) {
    std::vector<std::pair<std::string, std::string>> confused;
    for (const auto& [english, local] : options)
        for (const auto& [other_english, other_local] : options)
            if (english != other_english && (local == other_local || local == other_english))
                confused.emplace_back(english, other_english);
    return confused;
}

std::set<std::filesystem::path> sourcesOf(const Module& module) {
    std::set<std::filesystem::path> sources;
    for (const TextUse& use : module.uses)
        sources.insert(use.file);
    return sources;
}

const Table& tableOf(std::string_view module, std::size_t language) {
    const auto found = std::ranges::find_if(
        modules(), [&](const Module& candidate) { return candidate.folder.filename() == module; });
    return found->tables[language];
}

TEST(Words, AreTranslated) {
    forEveryText(
        [](const Module& module, const Table& table, const TextKey& key, const std::string& text) {
            for (const std::string& english : module.englishOf(key)) {
                if (isName(english) || isCognate(table.language, english) || !hasWords(english))
                    continue;
                const bool is_east_asian = table.language == "ja" || table.language == "zh";
                if (english == text || (is_east_asian && !hasEastAsianCharacters(text)))
                    ADD_FAILURE() << placeOf(table, key) << " is English: " << text;
            }
        });
}

TEST(Words, AreTheSameWhereverTheEnglishOnesAre) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        std::map<std::string, std::pair<std::string, std::string>> seen;
        for (const Module& module : modules())
            for (const auto& [key, text] : module.tables[language].texts)
                for (const std::string& english : module.englishOf(key)) {
                    if (hasSeveralSenses(english))
                        continue;
                    const std::string place = placeOf(module.tables[language], key);
                    const auto first =
                        seen.try_emplace(bare(english), bare(text), place + ": " + text).first;
                    if (first->second.first != bare(text))
                        ADD_FAILURE() << "\"" << english << "\" is in " << first->second.second
                                      << "\nbut in " << place << ": " << text;
                }
    }
}

/// An option is called by its local or its English name, so neither may be another option's.
TEST(Words, TellTheOptionsOfASourceApart) {
    std::size_t compared = 0;
    for (const Module& module : modules())
        for (const std::filesystem::path& source : sourcesOf(module))
            for (const Table& table : module.tables) {
                const auto options = optionsOf(source, module, table);
                compared += options.size();
                for (const auto& [one, other] : confusedOptions(options))
                    ADD_FAILURE() << placeOf(table.file) << ": \"" << one << "\" and \"" << other
                                  << "\" of " << placeOf(source) << " are called the same";
            }
    EXPECT_GT(compared, 100U);
}

/// A record keeps the name of its capture method, and each command compares it by another number.
TEST(Words, OfCaptureMethodsAgreeUnderAllTheirNumbers) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        const Table& table = tableOf("zoetrix", language);
        const auto text = [&](Space space, int number) { return table.texts.at({space, number}); };
        for (const int number : {19748, 20762})
            EXPECT_EQ(text(Space::strings, 19750), text(Space::strings, number)) << table.file;
        for (const int number : {19749, 20763})
            EXPECT_EQ(text(Space::strings, 19751), text(Space::strings, number)) << table.file;
        EXPECT_EQ(text(Space::strings, 19750), text(Space::option_names, 18437)) << table.file;
        EXPECT_EQ(text(Space::strings, 19751), text(Space::option_names, 18438)) << table.file;
    }
}

/// The names of modes become options, beside those of the renderers.
TEST(Words, OfCaptureMethodsAndDisplayModesAreAllDifferent) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        const auto& plug_in = tableOf("zoetrix", language).texts;
        const auto& host = tableOf("host", language).texts;
        std::multiset<std::string> options;
        const auto add = [&options](const std::string& name) {
            EXPECT_EQ(name.find_first_of(" _-,"), std::string::npos) << name;
            options.insert(bare(name));
        };
        for (const int number : {19750, 19751})
            add(plug_in.at({Space::strings, number}));
        for (const int number : {19747, 20121})
            add(host.at({Space::strings, number}));
        for (const int number : {32015, 43001, 43002, 43003, 43004})
            options.insert(bare(host.at({Space::strings, number})));
        for (const std::string& name : options)
            EXPECT_EQ(options.count(name), 1U) << LANGUAGES[language] << " " << name;
    }
}

/// A new record of the plug-in has the host's wireframe mode by its local name.
TEST(Words, OfTheFirstCaptureMethodAreThoseOfTheHost) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language)
        EXPECT_EQ(tableOf("host", language).texts.at({Space::strings, 32015}),
                  tableOf("zoetrix", language).texts.at({Space::strings, 32015}))
            << LANGUAGES[language];
}

} // namespace
} // namespace locale_rules
