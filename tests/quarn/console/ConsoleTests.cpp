#include "tests/quarn/Models.h"
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Terminal.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

constexpr const char* IDLE = "Command: ";
constexpr const char* FRAMES = "Number of frames <100>: ";
constexpr const char* DIRECTION = "Direction <Clockwise> ( Clockwise AntiClockwise ): ";

class Console : public testing::Test {
protected:
    Console() { writeHouse(m_folder / "house.obj"); }

    Start start(const std::vector<std::string>& arguments = {}) const {
        Start start;
        start.folder = m_folder.path();
        start.environment = {{"XDG_STATE_HOME", (m_folder / "state").native()}, {"LC_ALL", "C"}};
        start.arguments = {"console"};
        start.arguments.insert(start.arguments.end(), arguments.begin(), arguments.end());
        return start;
    }

    Ended feed(const std::string& input, const std::vector<std::string>& arguments = {}) const {
        Start piped = start(arguments);
        piped.input = input;
        return run(piped);
    }

    TempFolder m_folder;
};

// ---- At a terminal

TEST_F(Console, CompletesTheNameOfACommandAndRunsIt) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("sett\t");
    ASSERT_TRUE(terminal.shows("SetTurntableAnimation ")) << terminal.screen();
    terminal.type("\r");
    EXPECT_TRUE(terminal.shows(FRAMES)) << terminal.screen();
}

TEST_F(Console, ListsTheNamesThatACompletionLeavesOpen) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("View\t");
    ASSERT_TRUE(terminal.shows("ViewFirstFrame")) << terminal.screen();
    ASSERT_TRUE(terminal.shows("ViewPreviousFrame"));
    ASSERT_TRUE(terminal.shows("Command: View"));
    terminal.type("L\t\r");
    ASSERT_TRUE(terminal.shows("LastFrame \n")) << terminal.screen();
    ASSERT_TRUE(terminal.shows(IDLE));
    EXPECT_THAT(terminal.between(), Not(HasSubstr("Unknown command")));
}

TEST_F(Console, CompletesOptionsOfAQuestion) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("SetTurntableAnimation 8\r");
    ASSERT_TRUE(terminal.shows(DIRECTION)) << terminal.screen();
    terminal.type("ant\t");
    ASSERT_TRUE(terminal.shows("AntiClockwise")) << terminal.screen();
    terminal.type("\r");
    EXPECT_TRUE(terminal.shows("File type <jpg> ( jpg bmp png tga ): ")) << terminal.screen();
}

TEST_F(Console, CompletesFilesBehindACommandAndAtATextQuestion) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Import hou\t");
    ASSERT_TRUE(terminal.shows("house.obj"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Import\r");
    ASSERT_TRUE(terminal.shows("): ")) << terminal.screen();
    terminal.type("ho\t\r");
    ASSERT_TRUE(terminal.shows("house.obj"));
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("List\r");
    EXPECT_TRUE(terminal.shows("4 meshes")) << terminal.screen();
}

TEST_F(Console, ListsAHundredOfManyFiles) {
    for (int i = 1000; i < 1120; ++i)
        writeFile(m_folder / ("part" + std::to_string(i) + ".stl"), "");
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Import part\t");
    ASSERT_TRUE(terminal.shows("part1")) << terminal.screen();
    terminal.type("\t");
    ASSERT_TRUE(terminal.shows("part1099.stl")) << terminal.screen();
    EXPECT_TRUE(terminal.shows("and 20 more\nCommand: Import part1"));
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("part1100.stl")));
}

TEST_F(Console, AsksAgainAfterABadAnswer) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("SetTurntableAnimation\r");
    for (const char* answer : {"many\r", "0\r", "2.5\r"}) {
        ASSERT_TRUE(terminal.shows(FRAMES)) << terminal.screen();
        terminal.type(answer);
        ASSERT_TRUE(terminal.shows("Enter a ")) << terminal.screen();
    }
    ASSERT_TRUE(terminal.shows(FRAMES));
    terminal.type("8\r");
    EXPECT_TRUE(terminal.shows(DIRECTION));
}

TEST_F(Console, CtrlCAtAQuestionCancelsTheCommandAlone) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    for (int i = 0; i < 3; ++i) { // each is the first one again
        terminal.type("SetTurntableAnimation\r");
        ASSERT_TRUE(terminal.shows(FRAMES)) << terminal.screen();
        terminal.type(CTRL_C);
        ASSERT_TRUE(terminal.shows("Nothing done")) << terminal.screen();
        ASSERT_TRUE(terminal.shows(IDLE));
    }
    terminal.type("List\r");
    EXPECT_TRUE(terminal.shows("0 meshes"));
}

TEST_F(Console, CtrlCAtTheIdlePromptDropsTheLine) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Exit");
    ASSERT_TRUE(terminal.shows("Exit"));
    terminal.type(CTRL_C);
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("\rList\r");
    EXPECT_TRUE(terminal.shows("0 meshes"));
}

TEST_F(Console, CtrlDEndsAtTheIdlePromptAndCancelsAtAQuestion) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("SetTurntableAnimation\r");
    ASSERT_TRUE(terminal.shows(FRAMES));
    terminal.type(CTRL_D);
    ASSERT_TRUE(terminal.shows(IDLE)) << terminal.screen();
    terminal.type(CTRL_D);
    EXPECT_EQ(terminal.end().exit_code, 0);
}

TEST_F(Console, ExitEnds) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("exit\r");
    const Ended ended = terminal.end();
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_TRUE(ended.out.ends_with("\n")) << ended.out;
}

TEST_F(Console, RequestToTerminateEnds) {
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.sendSignal(SIGTERM);
    EXPECT_EQ(terminal.end().exit_code, 143);
}

TEST_F(Console, CallsBackLinesOfThisRunAndOfEarlierOnes) {
    {
        Terminal first(start());
        ASSERT_TRUE(first.shows(IDLE));
        first.type("größe\r");
        ASSERT_TRUE(first.shows("Unknown command: größe"));
        ASSERT_TRUE(first.shows(IDLE));
        first.type("List\r");
        ASSERT_TRUE(first.shows("0 meshes"));
        ASSERT_TRUE(first.shows(IDLE));
        first.type(std::string(UP) + "\r");
        ASSERT_TRUE(first.shows("0 meshes"));
        first.type("Exit\r");
        EXPECT_EQ(first.end().exit_code, 0);
    }
    EXPECT_THAT(linesOf(readFile(m_folder / "state/quarn/history")),
                ElementsAre("größe", "List", "List", "Exit"));
    Terminal second(start());
    ASSERT_TRUE(second.shows(IDLE));
    second.type(std::string(UP) + UP + UP + "\r");
    EXPECT_TRUE(second.shows("Unknown command: größe")) << second.screen();
}

TEST_F(Console, WorksWithoutAFolderForItsHistory) {
    writeFile(m_folder / "file", "");
    Start no_history = start();
    no_history.environment["XDG_STATE_HOME"] = (m_folder / "file").native();
    Terminal terminal(no_history);
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Exit\r");
    EXPECT_EQ(terminal.end().exit_code, 0);
}

TEST_F(Console, BreaksAQuestionThatIsTooWideBetweenItsWords) {
    Terminal terminal(start(), 60);
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("SetTurntableAnimation 8 Clockwise jpg\r");
    ASSERT_TRUE(terminal.shows("Frame capture method <Wireframe>")) << terminal.screen();
    ASSERT_TRUE(terminal.shows("): "));
    EXPECT_THAT(terminal.between(), HasSubstr("\n"));
    for (const char* option : {"[RenderFull]", "[RenderedViewport]", "[XRay]", "[Clay] "})
        EXPECT_THAT(terminal.between(), HasSubstr(option));
    terminal.type("[\t");
    EXPECT_TRUE(terminal.shows("[RenderPreview]")) << terminal.screen();
}

TEST_F(Console, CtrlCEndsARecordingWithWholePicturesAndGoesOn) {
    Terminal terminal(start({"house.obj"}));
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("ViewportSize 64 48\r");
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("SetTurntableAnimation 100000 Clockwise jpg Shaded Perspective House\r");
    ASSERT_TRUE(terminal.shows(IDLE)) << terminal.screen();
    terminal.type("RecordAnimation TargetFolder .\r");
    ASSERT_TRUE(terminal.shows("Press Enter to start recording")) << terminal.screen();
    ASSERT_TRUE(terminal.shows("): "));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows(" of 100000, ")) << terminal.screen();
    terminal.type(CTRL_C);
    ASSERT_TRUE(terminal.shows("Stopped.")) << terminal.screen();
    ASSERT_TRUE(terminal.shows(IDLE));
    for (const std::string& name : filesIn(m_folder.path()))
        EXPECT_TRUE(!name.ends_with(".jpg") || readPictureHeader(m_folder / name)) << name;
    terminal.type("List\r");
    EXPECT_TRUE(terminal.shows("2 meshes")) << terminal.screen();
}

// ---- Without a terminal

TEST_F(Console, ReadsAPipeAndShowsItAsIfItWereTyped) {
    const Ended ended = feed("Help List\n# a note\n\nSetTurntableAnimation 8 Clockwise\nnone\n"
                             "_Cancel\nExit\nList\n");
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.err, IsEmpty());
    const std::vector<std::string> lines = linesOf(ended.out);
    ASSERT_THAT(lines, SizeIs(testing::Gt(5u))) << ended.out;
    EXPECT_EQ(lines[0], "Command: Help List");
    EXPECT_THAT(lines[1], StartsWith("List  "));
    EXPECT_EQ(lines[2], "Command: # a note");
    EXPECT_EQ(lines[3], "Command: ");
    EXPECT_EQ(lines[4], "Command: SetTurntableAnimation 8 Clockwise");
    EXPECT_THAT(lines[5], StartsWith("File type <jpg> ( jpg bmp png tga ): none"));
    EXPECT_EQ(lines.back(), "Command: Exit");
    EXPECT_FALSE(std::filesystem::exists(m_folder / "state"));
}

TEST_F(Console, EndsWithItsInputAlsoInTheMiddleOfACommand) {
    for (const char* input : {"", "List", "SetTurntableAnimation\n8\n"}) {
        const Ended ended = feed(input);
        EXPECT_EQ(ended.exit_code, 0) << input;
        EXPECT_TRUE(ended.out.ends_with("\nCommand: \n") || ended.out == "Command: \n")
            << ended.out;
    }
    EXPECT_THAT(feed("SetTurntableAnimation\n").out,
                HasSubstr("needs an answer to \"Number of frames\""));
}

TEST_F(Console, TakesLinesOfOtherSystemsAndPathsInQuotes) {
    const Ended ended = feed("Import\r\n\"house.obj\"\r\nList\r\n");
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.out, HasSubstr("2 meshes")) << ended.out;
}

TEST_F(Console, ReadsTheModelFirst) {
    EXPECT_THAT(feed("List\n", {"house.obj"}).out, HasSubstr("2 meshes"));
    const Ended missing = feed("List\n", {"missing.obj"});
    EXPECT_EQ(missing.exit_code, 1);
    EXPECT_THAT(linesOf(missing.err), SizeIs(1));
    EXPECT_THAT(missing.err, HasSubstr("missing.obj"));
    EXPECT_THAT(missing.out, IsEmpty());
}

TEST_F(Console, SpeaksTheUsersLanguage) {
    const Ended ended = feed("_SetTurntableAnimation\n", {"--language", "de"});
    EXPECT_THAT(ended.out, HasSubstr("Anzahl")) << ended.out;
}

} // namespace
} // namespace quarn::test
