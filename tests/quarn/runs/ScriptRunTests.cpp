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
    EXPECT_THAT(ended.out, Not(HasSubstr("meshes")));
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
