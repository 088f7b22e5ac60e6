// Every command, script and option that a page or a help text shows is one that works.
#include "tests/quarn/Pictures.h"
#include "tests/quarn/pages/PrintedCommands.h"
#include "tests/quarn/pages/Workshop.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <map>
#include <regex>
#include <set>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::PrintToString;

using Words = std::vector<std::string>;

/// What cannot be run here, and why.
const std::map<std::string, std::string> NOT_RUN = {
    {"build/release/bin/quarn-desktop house.glb", "a window; its tests are desktop_window_tests"},
    {"build/release/bin/quarn-desktop model.glb", "a window; its tests are desktop_window_tests"},
    {"quarn console --language <language>", "a person chooses the language"},
    {"quarn record --overwrite", "names a command with an option, in a table"},
    {"quarn flythrough --camera-curve walk.txt", "names an option of a command in a sentence"},
    {"quarn turntable ... --show-script", "names an option of a command in a sentence"},
};

/// What stands for a word of the person's in a synopsis: by the option before it, or by itself.
const std::map<std::string, std::string> CHOSEN = {
    {"--path NAME", "Walk"},     {"--camera NAME", "Walk"},     {"--target NAME", "Fountain"},
    {"--place NAME", "Rome"},    {"--date DATE", "2026-06-21"}, {"--from DATE", "2026-06-21"},
    {"--to DATE", "2026-06-28"}, {"--frames N", "2"},           {"--number K", "1"},
    {"--out DIR", "out"},        {"--out FILE", "a.png"},       {"MODEL", "town.obj"},
    {"[MODEL]", "town.obj"},     {"DOC", "house.quarn"},        {"SCRIPT", "steps.txt"},
    {"status DIR", "farmed"},    {"cancel DIR", "farmed"},      {"DIR", "frames"},
    {"--frames RANGES", "0-1"},  {"[TEXT]", "greece"},          {"FOLDER", "frames"},
    {"FILE", "film.mp4"},
};

/// The words after the program's name, with words of a person's put in; a synopsis in help goes on
/// with what the command does, behind two blanks.
Words argumentsIn(const std::string& line) {
    Words words = shellWords(line.substr(0, line.find("   ")));
    while (words.front() != "quarn" && !words.front().ends_with("/quarn"))
        words.erase(words.begin()); // what is put into the environment
    words.erase(words.begin());
    for (std::size_t i = 0; i < words.size(); ++i) {
        const auto with_option = CHOSEN.find((i > 0 ? words[i - 1] : "") + " " + words[i]);
        const auto alone = CHOSEN.find(words[i]);
        if (with_option != CHOSEN.end())
            words[i] = with_option->second;
        else if (alone != CHOSEN.end())
            words[i] = alone->second;
    }
    return words;
}

/// Whether a line says no more than what a command is called.
bool isNameAlone(const Words& arguments) {
    static const std::set<std::string> complete = {"places", "console", "--help", "--version"};
    if (arguments.size() == 2 && arguments[0] == "farm")
        return true;
    return arguments.empty() || (arguments.size() == 1 && !complete.contains(arguments[0])) ||
           arguments.back() == "...";
}

void setOption(const std::string& name, const std::string& value, Words& arguments) {
    const auto found = std::ranges::find(arguments, name);
    if (found == arguments.end())
        arguments.insert(arguments.end(), {name, value});
    else
        *(found + 1) = value;
}

bool isRecording(const std::string& command) {
    static const std::set<std::string> recordings = {"turntable", "flythrough", "path", "day",
                                                     "season"};
    return recordings.contains(command);
}

/// The same recording of few and small pictures.
Words made(Words arguments) {
    const std::string command = arguments[0];
    setOption("--size", "64x48", arguments);
    if (std::ranges::count(arguments, "--save") > 0)
        setOption("--save", "made.quarn",
                  arguments); // the workshop's has the frames that are named
    if (!isRecording(command))
        return arguments;
    if (command == "day")
        setOption("--every", "720", arguments);
    else if (command == "season")
        setOption("--every", "400", arguments);
    else
        setOption("--frames", "2", arguments);
    if (std::ranges::find(arguments, "RenderFull") != arguments.end())
        setOption("--samples", "1", arguments);
    return arguments;
}

void expectWorks(const Workshop& workshop, const Words& arguments) {
    const Ended ended = workshop.run(arguments, "Exit\n");
    EXPECT_EQ(ended.exit_code, 0) << PrintToString(arguments) << "\n" << ended.err;
    EXPECT_THAT(ended.err, IsEmpty()) << PrintToString(arguments);
}

void expectCommandWorks(const Workshop& workshop, const Words& arguments) {
    const bool is_shown = std::ranges::count(arguments, "--show-script") > 0;
    if (!is_shown && isRecording(arguments[0])) {
        Words shown = arguments;
        shown.push_back("--show-script");
        expectWorks(workshop, shown);
    }
    const bool has_size =
        isRecording(arguments[0]) || arguments[0] == "frame" || arguments[0] == "sunhours";
    expectWorks(workshop, has_size && !is_shown ? made(arguments) : arguments);
}

Words sources() {
    Words all = pages();
    all.push_back("quarn --help");
    for (const std::string& command : subcommands())
        all.push_back("quarn " + command + " --help");
    return all;
}

/// A page or a help text.
class PrintedSource : public testing::TestWithParam<std::string> {
protected:
    Workshop m_workshop;
};

TEST_P(PrintedSource, HoldsCommandsAndScriptsThatRun) {
    for (const std::string& line :
         commandLines(GetParam(), {"quarn ", "build/release/bin/", "QUARN_STRICT=1 "})) {
        if (NOT_RUN.contains(line))
            continue;
        const Words arguments = argumentsIn(line);
        if (!isNameAlone(arguments))
            expectCommandWorks(m_workshop, arguments);
    }
    std::string script = printedScript(GetParam());
    script = std::regex_replace(script, std::regex("_Size \\d+ \\d+ _Samples \\d+"),
                                "_Size 64 48 _Samples 1");
    script = std::regex_replace(script, std::regex("Animation 36 "), "Animation 2 ");
    writeFile(m_workshop / "printed.txt", "_-ViewportSize 64 48\n" + script);
    expectWorks(m_workshop, {"run", "printed.txt", "house.obj"});
}

std::string nameOf(const testing::TestParamInfo<std::string>& source) {
    return std::regex_replace(source.param, std::regex("[^A-Za-z0-9]+"), "_");
}

INSTANTIATE_TEST_SUITE_P(Each, PrintedSource, testing::ValuesIn(sources()), nameOf);

// ---- The lists above

TEST(PrintedCommands, ThatAreNotRunAreStillPrinted) {
    Words printed;
    for (const std::string& source : sources())
        for (const std::string& line : commandLines(source, {"quarn", "build/"}))
            printed.push_back(line);
    for (const auto& [line, reason] : NOT_RUN)
        EXPECT_THAT(printed, Contains(line)) << reason;
}

TEST(PrintedCommands, AreFoundInBlocksInSentencesAndInHelp) {
    EXPECT_THAT(commandLines("docs/flythrough.md", {"quarn "}),
                Contains("quarn curves pavilion.obj"));
    EXPECT_THAT(commandLines("docs/flythrough.md", {"quarn "}),
                Contains("quarn frame walk.quarn --number 120 --out still.png --size 3840x2160"));
    EXPECT_THAT(commandLines("quarn run --help", {"quarn "}),
                Contains("quarn run steps.txt house.glb"));
    EXPECT_THAT(printedScript("quarn run --help"), HasSubstr("_-RecordAnimation"));
    EXPECT_THAT(subcommands(), Contains("console"));
}

TEST(PrintedConsole, AsksWhatHelpShows) {
    const Words help = linesOf(helpOf("console"));
    const auto typed = std::ranges::find_if(
        help, [](const std::string& line) { return line.starts_with("  Command: "); });
    ASSERT_LT(typed, help.end() - 1);
    const Workshop workshop;
    const std::string asked =
        workshop
            .run({"console", "house.glb"}, typed->substr(std::string("  Command: ").size()) + "\n")
            .out;
    EXPECT_THAT(asked, HasSubstr("\n" + (typed + 1)->substr(2)));
}

// ---- Names

std::set<std::string> optionsIn(const std::string& text) {
    static const std::regex option("--[a-z][a-z-]*");
    return {std::sregex_token_iterator(text.begin(), text.end(), option), {}};
}

TEST(PrintedOptions, AreThoseOfSomeProgram) {
    std::set<std::string> known = {"--preset", "--build", // of cmake
                                   "--run-script",        // of the window
                                   "--gtest"};            // of the test programs
    known.insert({"--sshloginfile", "--joblog"});         // of GNU parallel
    for (const std::string& command : subcommands()) {
        const std::string help = helpOf(command);
        // An option is told behind the heading; what the texts below name must be one.
        const std::string table = help.substr(0, help.find("\n\n\n"));
        known.merge(optionsIn(table));
    }
    known.merge(optionsIn(run({"--help"}).out.substr(0, 500)));
    for (const std::string& source : sources())
        for (const std::string& option : optionsIn(printedText(source)))
            EXPECT_TRUE(known.contains(option)) << option << " in " << source;
}

/// Words of two humps on the pages for those who use the programs.
TEST(PrintedNames, AreThoseOfHostCommandsOrOfTheirOptions) {
    const std::set<std::string> options = {"RenderFull", "PlaceAndTime", "TimeZone",
                                           "PreviewSamples", "RenderPreview"};
    const std::string commands = Workshop().run({"console"}, "Help\n").out;
    static const std::regex name("`([A-Z][a-z]+[A-Z][A-Za-z]*)`");
    for (const char* page :
         {"README.md", "docs/flythrough.md", "docs/curve-files.md", "docs/display-modes.md",
          "docs/light.md", "docs/rendering.md", "docs/sun-studies.md", "docs/materials.md",
          "docs/model-files.md", "docs/window.md"}) {
        const std::string text = printedText(page);
        for (std::sregex_iterator found(text.begin(), text.end(), name), end; found != end;
             ++found) {
            const std::string word = (*found)[1];
            EXPECT_TRUE(options.contains(word) ||
                        commands.find("\n" + word + " ") != std::string::npos)
                << word << " in " << page;
        }
    }
}

TEST(PrintedDevCommands, AreThoseThatTheScriptLists) {
    const std::string script = printedText("dev");
    for (const std::string& source : pages())
        for (const std::string& line : commandLines(source, {"./dev "}))
            EXPECT_THAT(script, HasSubstr("\n  " + shellWords(line)[1] + " ")) << line;
}

} // namespace
} // namespace quarn::test
