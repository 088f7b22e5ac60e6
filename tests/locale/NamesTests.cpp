#include "tests/locale/Places.h"

#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <set>

namespace locale_rules {
namespace {

/// Options are told apart whatever their case.
std::string lowered(const std::string& text) {
    KM_wString lower = KM_wString::FromUtf8(text);
    lower.MakeLower();
    return lower.ToUtf8();
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
            options[lowered(*use.english)] =
                lowered(table.texts.at({Space::option_names, use.number}));
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

/// An option is called by its local or its English name, so neither may be another option's.
TEST(Names, TellTheOptionsOfASourceApart) {
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
TEST(Names, OfCaptureMethodsAgreeUnderAllTheirNumbers) {
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
TEST(Names, OfCaptureMethodsAndDisplayModesAreAllDifferent) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language) {
        const auto& plug_in = tableOf("zoetrix", language).texts;
        const auto& host = tableOf("host", language).texts;
        std::multiset<std::string> options;
        const auto add = [&options](const std::string& name) {
            EXPECT_EQ(name.find_first_of(" _-,"), std::string::npos) << name;
            options.insert(lowered(name));
        };
        for (const int number : {19750, 19751})
            add(plug_in.at({Space::strings, number}));
        for (const int number : {19747, 20121})
            add(host.at({Space::strings, number}));
        for (const int number : {32015, 43001, 43002, 43003, 43004})
            options.insert(lowered(host.at({Space::strings, number})));
        for (const std::string& name : options)
            EXPECT_EQ(options.count(name), 1U) << LANGUAGES[language] << " " << name;
    }
}

/// A new record of the plug-in has the host's wireframe mode by its local name.
TEST(Names, OfTheFirstCaptureMethodAreThoseOfTheHost) {
    for (std::size_t language = 0; language < std::size(LANGUAGES); ++language)
        EXPECT_EQ(tableOf("host", language).texts.at({Space::strings, 32015}),
                  tableOf("zoetrix", language).texts.at({Space::strings, 32015}))
            << LANGUAGES[language];
}

} // namespace
} // namespace locale_rules
