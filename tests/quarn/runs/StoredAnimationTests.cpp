#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <string>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

constexpr int FRAMES = 5;

/// A folder with a document that one process made, for others to open.
class StoredAnimation : public testing::Test {
protected:
    StoredAnimation() {
        fs::create_directory(m_studio / "first");
        fs::create_directory(m_studio / "second");
        const Ended ended = runScript("_-ViewportSize 96 64\n"
                                      "_-AnimationName \"Tower\"\n"
                                      "_-SetTurntableAnimation 5 _Clockwise _png _RenderedViewport "
                                      "_Enter _Enter\n"
                                      "_-SaveAs \"tower.quarn\"\n"
                                      "_-RecordAnimation _TargetFolder \"first\" _Enter\n",
                                      "house.obj");
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_TRUE(fs::exists(m_studio / "tower.quarn"));
    }

    Ended runScript(const std::string& text, const std::string& opened) const {
        writeFile(m_studio / "steps.txt", text);
        Start start;
        start.folder = m_studio.path();
        start.arguments = {"run", "steps.txt", opened, "--language", "en"};
        return run(start);
    }

    /// The bytes of a frame that a recording into `folder` wrote.
    std::string frame(const std::string& folder, int number) const {
        const std::string digits = std::to_string(number);
        for (const auto& entry : fs::recursive_directory_iterator(m_studio / folder)) {
            const std::string stem = entry.path().stem().string();
            if (entry.path().extension() == ".png" && stem.ends_with(digits))
                return readFile(entry.path());
        }
        return {};
    }

    Studio m_studio;
};

TEST_F(StoredAnimation, IsRecordedAsTheSameFilesByAnotherProcess) {
    const Ended ended =
        runScript("_-RecordAnimation _TargetFolder \"second\" _Enter\n", "tower.quarn");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    for (int number = 0; number < FRAMES; ++number) {
        ASSERT_FALSE(frame("first", number).empty());
        EXPECT_EQ(frame("first", number), frame("second", number)) << "frame " << number;
    }
    EXPECT_NE(frame("first", 0), frame("first", 1));
}

TEST_F(StoredAnimation, IsSteppedAndPlayedByAnotherProcess) {
    const Ended ended = runScript("_-ViewFrameNumber 3\n"
                                  "_-ViewNextFrame\n"
                                  "_-ViewNextFrame\n"
                                  "_-ViewPreviousFrame\n"
                                  "_-ViewLastFrame\n"
                                  "_-ViewFirstFrame\n"
                                  "_-PlayAnimation\n",
                                  "tower.quarn");
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
}

TEST_F(StoredAnimation, IsWrittenFrameByFrameByOtherProcessesAsTheSameFiles) {
    for (int number = 0; number < FRAMES; ++number) {
        const Ended ended =
            runScript("_-SaveFrame " + std::to_string(number) + " \"one.png\"\n", "tower.quarn");
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_EQ(frame("first", number), readFile(m_studio / "one.png")) << "frame " << number;
    }
}

TEST_F(StoredAnimation, IsToldOfByInfo) {
    const Ended ended = run({"info", (m_studio / "tower.quarn").string()});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("animation: turntable, 5 frames in Perspective\n"));
}

TEST_F(StoredAnimation, IsStillThereAfterAnotherSave) {
    ASSERT_EQ(runScript("_-SaveAs \"again.quarn\"\n", "tower.quarn").exit_code, 0);
    EXPECT_EQ(readFile(m_studio / "tower.quarn"), readFile(m_studio / "again.quarn"));
}

TEST_F(StoredAnimation, IsNotInAFileOfVersionThreeNorInOneOfSelectedObjects) {
    ASSERT_EQ(runScript("_-SaveAs [Version] 3 \"three.quarn\"\n"
                        "_-SaveAs [Version] 4 \"four.quarn\"\n"
                        "_-Select _All\n"
                        "_-SaveSelected \"selected.quarn\"\n",
                        "tower.quarn")
                  .exit_code,
              0);
    for (const char* without : {"three.quarn", "selected.quarn"}) {
        const Ended ended = runScript("_-ViewFirstFrame\n", without);
        EXPECT_EQ(ended.exit_code, 1) << without;
        EXPECT_THAT(ended.out + ended.err, HasSubstr("No animation is currently set")) << without;
    }
    EXPECT_EQ(runScript("_-ViewFirstFrame\n", "four.quarn").exit_code, 0);
}

TEST_F(StoredAnimation, IsReplacedByTheOneOfAnImportedFile) {
    const Ended ended = runScript("_-SetTurntableAnimation 9 _Clockwise _png _RenderedViewport "
                                  "_Enter _Enter\n"
                                  "_-Import \"tower.quarn\"\n"
                                  "_-ViewFrameNumber 5\n",
                                  "house.obj");
    EXPECT_EQ(ended.exit_code, 1) << "there are frames 0 to 4";
}

TEST_F(StoredAnimation, IsGoneAfterNewAndAfterOpeningAFileWithoutOne) {
    for (const char* other : {"_-New\n", "_-Open \"house.obj\"\n"}) {
        const Ended ended = runScript(std::string(other) + "_-ViewFirstFrame\n", "tower.quarn");
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(ended.out + ended.err, HasSubstr("No animation is currently set"));
    }
}

TEST_F(StoredAnimation, ADocumentThatWasCutOffIsNamed) {
    const std::string whole = readFile(m_studio / "tower.quarn");
    writeFile(m_studio / "cut.quarn", std::string_view(whole).substr(0, whole.size() / 2));
    const Ended ended = runScript("_-Open \"cut.quarn\"\n", "tower.quarn");
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("cut.quarn: it is damaged or was cut off"));
}

TEST_F(StoredAnimation, AProgramKilledWhileItSavesLeavesAWholeFile) {
    std::string text;
    for (int i = 0; i < 3000; ++i)
        text += "_-SaveAs \"tower.quarn\"\n";
    const std::string whole = readFile(m_studio / "tower.quarn");
    writeFile(m_studio / "steps.txt", text);
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"run", "steps.txt", "tower.quarn", "--language", "en"};
    int killed = 0;
    for (int round = 0; round < 8; ++round) {
        const auto before = fs::last_write_time(m_studio / "tower.quarn");
        RunningProgram program(start);
        ASSERT_TRUE(program.waitUntil(
            [&] { return fs::last_write_time(m_studio / "tower.quarn") != before; }));
        program.sendSignal(SIGKILL);
        killed += program.wait().killed_by == SIGKILL ? 1 : 0;
        ASSERT_EQ(whole, readFile(m_studio / "tower.quarn"));
    }
    EXPECT_GT(killed, 0) << "every run was over before it could be killed";
}

} // namespace
} // namespace quarn::test
