#include "tests/quarn/Pictures.h"
#include "tests/quarn/Recording.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <regex>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

constexpr int ENDLESS = 100000;

int picturesIn(const std::filesystem::path& folder) {
    int count = 0;
    for (const std::string& name : filesIn(folder))
        count += name.ends_with(".jpg");
    return count;
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
    for (const std::string& name : filesIn(studio / "out"))
        EXPECT_TRUE(name == "house.html" || readPictureHeader(studio / ("out/" + name)).has_value())
            << name;
}

INSTANTIATE_TEST_SUITE_P(Interruption, StopSignal, testing::Values(SIGINT, SIGTERM));

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
