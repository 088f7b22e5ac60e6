#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

class ScriptRun : public testing::Test {
protected:
    Ended runScript(const std::string& text, const std::vector<std::string>& more = {}) const {
        writeFile(m_studio / "steps.txt", text);
        Start start;
        start.folder = m_studio.path();
        start.arguments = {"run", "steps.txt", "--language", "en"};
        start.arguments.insert(start.arguments.end(), more.begin(), more.end());
        return run(start);
    }

    Studio m_studio;
};

TEST_F(ScriptRun, ReadsTheModelBeforeTheFirstCommand) {
    const Ended ended = runScript("_-List\n", {"house.obj"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("tower  mesh"));
}

TEST_F(ScriptRun, EndsAtAModelThatCannotBeRead) {
    const Ended ended = runScript("_-List\n", {"missing.obj"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("missing.obj"));
    EXPECT_THAT(ended.out, IsEmpty());
}

TEST_F(ScriptRun, TellsThatTheScriptIsMissing) {
    const Ended ended = run({"run", "/nowhere/steps.txt"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("/nowhere/steps.txt"));
}

TEST_F(ScriptRun, TellsThatTheScriptIsAFolder) {
    const Ended ended = run({"run", "/"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("/ is a folder"));
}

TEST_F(ScriptRun, OfAnEmptyScriptDoesNothing) {
    for (const char* script : {"", "\n\n", "# nothing\r\n   \r\n"}) {
        const Ended ended = runScript(script);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.out, IsEmpty());
    }
}

TEST_F(ScriptRun, StopsAtTheFirstCommandThatFails) {
    const Ended ended = runScript("_-List\n_-Turnip\n_-Import \"house.obj\"\n");
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("steps.txt, line 2"));
    EXPECT_THAT(ended.out, Not(HasSubstr("house.obj")));
}

TEST_F(ScriptRun, TellsOnceWhatEndedIt) {
    const Ended command = runScript("_-List\n_-Turnip\n");
    EXPECT_EQ(command.err, "quarn: steps.txt, line 2: _-Turnip: failed.\n");
    EXPECT_THAT(command.out, HasSubstr("Unknown command: Turnip."));
    EXPECT_THAT(command.out, Not(HasSubstr("line 2")));
    const Ended missing = run({"run", "/nowhere/steps.txt"});
    EXPECT_THAT(missing.out, IsEmpty());
    EXPECT_EQ(missing.err, "quarn: There is no file /nowhere/steps.txt.\n");
}

TEST_F(ScriptRun, OfAFileThatIsNoTextRefusesItInOneLine) {
    writeFile(m_studio / "model.glb", std::string("glTF\2\0\0\0\x9B\x1B[2J\n_-List\n", 21));
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"run", "model.glb"};
    const Ended binary = run(start);
    EXPECT_EQ(binary.exit_code, 1);
    EXPECT_THAT(binary.out, IsEmpty());
    EXPECT_THAT(linesOf(binary.err), SizeIs(1));
    EXPECT_THAT(binary.err, HasSubstr("model.glb is no script: line 1 holds control characters"));
}

TEST_F(ScriptRun, ShowsTheWordsOfTheModelThatItReads) {
    EXPECT_THAT(runScript("", {"house.obj"}).out, HasSubstr("house.obj: 2 objects"));
}

TEST_F(ScriptRun, NamesTheAnswerThatIsMissing) {
    const Ended ended = runScript("_-SetTurntableAnimation\n", {"house.obj"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("\"Number of frames\""));
}

TEST_F(ScriptRun, AViewThatIsNotThereEndsTheSetUp) {
    const Ended ended = runScript(
        "_-SetTurntableAnimation 3 _Clockwise _jpg _Shaded \"Back door\" _Enter\n", {"house.obj"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("Invalid viewport name. Nothing done\n"));
}

TEST_F(ScriptRun, WorksWithFilesOfAnyName) {
    writeFile(m_studio / "Schritte 一.txt", "_-List\n");
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"run", "Schritte 一.txt", "house.obj"};
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
}

} // namespace
} // namespace quarn::test
