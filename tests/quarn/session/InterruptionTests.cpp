#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <regex>
#include <thread>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

constexpr int ENDLESS = 100000;

int picturesIn(const std::filesystem::path& folder, const std::string& format = "jpg") {
    int count = 0;
    if (std::filesystem::exists(folder))
        for (const std::string& name : filesIn(folder))
            count += name.ends_with("." + format);
    return count;
}

/// Nothing is in the folder but whole pictures and the page; what a killed program was writing has
/// a hidden name.
void expectWholePicturesIn(const std::filesystem::path& folder) {
    for (const std::string& name : filesIn(folder))
        EXPECT_TRUE(name == "house.html" || name == "house.recording" ||
                    name == "house.frames.json" || name.ends_with(".journal") ||
                    name.starts_with('.') || readPictureHeader(folder / name).has_value())
            << name;
}

class StopSignal : public testing::TestWithParam<int> {};

TEST_P(StopSignal, LeavesWholePicturesAndAPageThatPlaysThem) {
    const Studio studio;
    RunningProgram program(studio.turntable(ENDLESS));
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(studio / "out/house004.jpg"); }));
    program.sendSignal(GetParam());
    const Ended ended = program.wait();

    EXPECT_EQ(ended.exit_code, 128 + GetParam());
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    const int count = picturesIn(studio / "out");
    EXPECT_GE(count, 5);
    EXPECT_THAT(ended.err, StartsWith("Stopped after " + std::to_string(count) +
                                      " of 100000 "
                                      "frames; out/house.html"));
    EXPECT_THAT(readFile(studio / "out/house.html"),
                HasSubstr("ImageCount = " + std::to_string(count) + ";"));
    expectWholePicturesIn(studio / "out");
}

INSTANTIATE_TEST_SUITE_P(Interruption, StopSignal, testing::Values(SIGINT, SIGTERM, SIGHUP));

TEST(Interruption, LeavesOffThePictureThatIsBeingRendered) {
    const Studio studio;
    RunningProgram program(
        studio.turntable(ENDLESS, {"--mode", "RenderFull", "--size", "200x150"}));
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(studio / "out/house001.jpg"); }));
    program.sendSignal(SIGINT);
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 130);
    const int count = picturesIn(studio / "out");
    EXPECT_GE(count, 2);
    EXPECT_THAT(ended.err, StartsWith("Stopped after " + std::to_string(count) + " of 100000 "));
    EXPECT_THAT(readFile(studio / "out/house.html"),
                HasSubstr("ImageCount = " + std::to_string(count) + ";"));
    expectWholePicturesIn(studio / "out");
}

/// Formats whose files tell that they end too early.
class KilledRecording : public testing::TestWithParam<const char*> {};

TEST_P(KilledRecording, LeavesWholePicturesOnlyAndCanBeMadeAgain) {
    const Studio studio;
    const std::vector<std::string> options = {"--format", GetParam(), "--size", "640x480"};
    for (const int later_ms : {0, 1, 3, 6, 10}) {
        RunningProgram program(studio.turntable(ENDLESS, options));
        ASSERT_TRUE(program.waitUntil([&] { return picturesIn(studio / "out", GetParam()) >= 3; }));
        std::this_thread::sleep_for(std::chrono::milliseconds(later_ms));
        program.sendSignal(SIGKILL);
        EXPECT_EQ(program.wait().killed_by, SIGKILL);
        EXPECT_GE(picturesIn(studio / "out", GetParam()), 3);
        expectWholePicturesIn(studio / "out");
        EXPECT_EQ(run(studio.turntable(1, options)).exit_code, 0);
        expectWholePicturesIn(studio / "out");
        std::filesystem::remove_all(studio / "out");
    }
}

INSTANTIATE_TEST_SUITE_P(Formats, KilledRecording, testing::Values("jpg", "png", "bmp"),
                         [](const auto& format) { return std::string(format.param); });

TEST(Interruption, SecondCtrlCEndsTheProgramAtOnce) {
    const Studio studio;
    RunningProgram program(studio.turntable(ENDLESS, {"--size", "2000x1500"}));
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(studio / "out/house000.jpg"); }));
    program.sendSignal(SIGINT);
    program.sendSignal(SIGTERM);
    const Ended ended = program.wait();
    EXPECT_TRUE(ended.exit_code == 130 || ended.exit_code == 143);
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_FALSE(std::filesystem::exists(studio / "out/house.html"));
}

TEST(Interruption, StopsAScriptBetweenItsCommands) {
    const Studio studio;
    std::filesystem::create_directory(studio / "out");
    Start show = studio.turntable(ENDLESS);
    show.arguments.push_back("--show-script");
    writeFile(studio / "steps.txt", run(show).out + "\n_-AnimationName \"After\"\n");
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "steps.txt"};
    RunningProgram program(start);
    ASSERT_TRUE(
        program.waitUntil([&] { return std::filesystem::exists(studio / "out/house002.jpg"); }));
    program.sendSignal(SIGINT);
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 130);
    EXPECT_THAT(ended.err, StartsWith("Stopped"));
    EXPECT_TRUE(std::filesystem::exists(studio / "out/house.html"));
}

TEST(Progress, IsRewrittenOnATerminalAndTakenAwayAtTheEnd) {
    const Studio studio;
    Start start = studio.turntable(12);
    start.has_terminal = true;
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0);
    EXPECT_TRUE(std::regex_search(
        ended.err, std::regex("\rframe [0-9]+ of 12, [0-9.]+ frames/s, [0-9]+ s left")))
        << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("frame 12 of 12"));
    EXPECT_TRUE(ended.err.ends_with("\r\x1b[K")) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("12 frames and out/house.html in "));
}

TEST(Progress, IsQuietWithoutATerminal) {
    const Studio studio;
    const Ended ended = run(studio.turntable(12));
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_THAT(linesOf(ended.out), SizeIs(1));
}

TEST(Progress, IsGoneBeforeAMessageIsShown) {
    const Studio studio;
    Start start = studio.turntableOf("missing.obj", 3);
    start.has_terminal = true;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("\r\x1b[Kquarn: "));
}

} // namespace
} // namespace quarn::test
