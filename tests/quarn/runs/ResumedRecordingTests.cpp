// Recordings that are stopped or killed, and go on.
#include "tests/quarn/runs/RecordedDocument.h"

#include <algorithm>
#include <csignal>
#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

constexpr int FRAMES = 60;
constexpr const char* SIZE = "320 240";

class ResumedRecording : public testing::Test {
protected:
    /// Starts a recording and ends it by a signal in its middle.
    Ended endInTheMiddle(const Start& start, int signal, const std::string& out = "out") const {
        RunningProgram program(start);
        EXPECT_TRUE(program.waitUntil([&] { return house.picturesIn(out) >= 5; }));
        program.sendSignal(signal);
        const Ended ended = program.wait();
        EXPECT_LT(house.picturesIn(out), FRAMES);
        return ended;
    }
    std::string whole() const {
        const Ended ended = run(house.record("whole"));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        return "whole";
    }

    const RecordedDocument house{FRAMES, SIZE};
};

TEST_F(ResumedRecording, ThatWasKilledKeepsItsFramesAndEndsAsIfItHadNotBeen) {
    EXPECT_EQ(endInTheMiddle(house.record("out"), SIGKILL).killed_by, SIGKILL);
    const int kept = house.picturesIn("out");
    const auto first = house.markOf("out/house000.jpg");
    const auto third = house.markOf("out/house003.jpg");
    const Ended ended = run(house.record("out"));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, MatchesRegex("60 frames and out/house.html in [0-9.]+ s \\([0-9]+ of "
                                        "them were there already\\)\n"));
    const int told = std::stoi(ended.out.substr(ended.out.find('(') + 1));
    EXPECT_LE(kept - told, 1) << "the last one may not have come to be noted";
    EXPECT_LE(told, kept);
    EXPECT_EQ(house.markOf("out/house000.jpg"), first);
    EXPECT_EQ(house.markOf("out/house003.jpg"), third);
    EXPECT_EQ(house.recorded("out"), house.recorded(whole()));
}

TEST_F(ResumedRecording, ThatAPersonStoppedTellsThatItGoesOn) {
    const Ended stopped = endInTheMiddle(house.record("out", {"--frames", "0-49"}), SIGINT);
    EXPECT_EQ(stopped.exit_code, 130);
    EXPECT_THAT(stopped.out, IsEmpty());
    EXPECT_THAT(stopped.err, MatchesRegex("Stopped after [0-9]+ of 50 frames\\. The same command "
                                          "goes on where it stopped\\.\n"));
    const int kept = house.picturesIn("out");
    EXPECT_THAT(stopped.err, HasSubstr("after " + std::to_string(kept) + " of"));
    const Ended ended = run(house.record("out", {"--frames", "0-49"}));
    EXPECT_THAT(ended.out, HasSubstr("(" + std::to_string(kept) + " of them were there already)"));
    EXPECT_EQ(endInTheMiddle(house.record("all"), SIGTERM, "all").exit_code, 143);
    EXPECT_EQ(run(house.record("all")).exit_code, 0);
    EXPECT_EQ(house.recorded("all"), house.recorded(whole()));
}

TEST_F(ResumedRecording, TellsOnATerminalHowFarTheFramesThatItMakesAre) {
    ASSERT_EQ(run(house.record("out", {"--frames", "0-39"})).exit_code, 0);
    Start start = house.record("out");
    start.has_terminal = true;
    const Ended ended = run(start);
    EXPECT_THAT(ended.err, HasSubstr("frame 20 of 20"));
    EXPECT_THAT(ended.err, Not(HasSubstr("of 60")));
}

TEST_F(ResumedRecording, ThatTwoProgramsMakeHasEachFrameOnceAndBothWait) {
    RunningProgram first(house.record("out"));
    RunningProgram second(house.record("out"));
    for (RunningProgram* const program : {&first, &second}) {
        const Ended ended = program->wait();
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.out, StartsWith("60 frames and out/house.html in "));
    }
    EXPECT_EQ(house.recorded("out"), house.recorded(whole()));
}

/// A program that is stopped for good holds a frame until its lease runs out: here it goes on.
TEST_F(ResumedRecording, ThatWaitsForAFrameOfAnotherIsStoppedWithIt) {
    RunningProgram first(house.record("out"));
    ASSERT_TRUE(first.waitUntil([&] { return house.picturesIn("out") >= 3; }));
    first.sendSignal(SIGSTOP);
    RunningProgram second(house.record("out"));
    ASSERT_TRUE(second.waitUntil([&] { return house.picturesIn("out") >= FRAMES - 1; }));
    second.sendSignal(SIGINT);
    const Ended ended = second.wait();
    EXPECT_TRUE(ended.exit_code == 130 || house.picturesIn("out") == FRAMES) << ended.err;
    first.sendSignal(SIGCONT);
    EXPECT_EQ(first.wait().exit_code, 0);
    EXPECT_EQ(house.recorded("out"), house.recorded(whole()));
}

// ---- Recordings of models

class RepeatedRecording : public testing::Test {
protected:
    Ended turntable(std::vector<std::string> options = {}) const {
        options.insert(options.begin(),
                       {"turntable", "house.obj", "--size", "64x48", "--out", "out"});
        if (std::ranges::find(options, "--frames") == options.end())
            options.insert(options.end(), {"--frames", "6"});
        return house.run(options);
    }

    const RecordedDocument house{1};
};

TEST_F(RepeatedRecording, OfTheSameKeepsItsFrames) {
    ASSERT_EQ(turntable().exit_code, 0);
    const auto files = house.recorded("out");
    const auto mark = house.markOf("out/house002.jpg");
    const Ended again = turntable();
    EXPECT_THAT(again.out, HasSubstr("6 frames and out/house.html"));
    EXPECT_THAT(again.out, HasSubstr("(all of them were there already)"));
    EXPECT_EQ(house.markOf("out/house002.jpg"), mark);
    writeFile(house / "out/house004.jpg", "cut");
    EXPECT_THAT(turntable().out, HasSubstr("(5 of them were there already)"));
    EXPECT_EQ(house.recorded("out"), files);
}

TEST_F(RepeatedRecording, OfAnotherIsMadeAnewUnlessTheFirstIsToGoOn) {
    ASSERT_EQ(turntable().exit_code, 0);
    const auto files = house.recorded("out");
    const Ended refused = turntable({"--elevation", "50", "--resume"});
    EXPECT_EQ(refused.exit_code, 1);
    EXPECT_THAT(refused.err, HasSubstr("house in out was recorded before "));
    EXPECT_EQ(house.recorded("out"), files);
    const Ended anew = turntable({"--elevation", "50"});
    EXPECT_EQ(anew.exit_code, 0) << anew.err;
    EXPECT_THAT(anew.out, Not(HasSubstr("already")));
    EXPECT_NE(house.recorded("out"), files);
    EXPECT_EQ(turntable({"--resume", "--overwrite"}).exit_code, 0);
    EXPECT_EQ(house.recorded("out"), files);
}

TEST_F(RepeatedRecording, IsSharedWithAnotherProgramThatGoesOnWithItToo) {
    std::vector<std::string> arguments = {"turntable", "house.obj", "--size",   "320x240",
                                          "--out",     "out",       "--frames", "60"};
    const auto end_of = [&](std::vector<std::string> more) {
        more.insert(more.begin(), arguments.begin(), arguments.end());
        return house.start(more);
    };
    RunningProgram first(end_of({"--resume"}));
    ASSERT_TRUE(first.waitUntil([&] { return house.picturesIn("out") >= 2; }));
    const Ended second = run(end_of({}));
    EXPECT_EQ(second.exit_code, 0) << second.err;
    EXPECT_EQ(first.wait().exit_code, 0);
    EXPECT_EQ(house.recorded("out").size(), 62U);
}

TEST_F(RepeatedRecording, HasItsKeptFramesInTheFilmToo) {
    ASSERT_EQ(turntable({"--video", "first.gif"}).exit_code, 0);
    std::filesystem::remove(house / "out/house003.jpg");
    const Ended again = turntable({"--video", "second.gif"});
    EXPECT_EQ(again.exit_code, 0) << again.err;
    EXPECT_THAT(again.out, HasSubstr("second.gif: 6 frames of 64 x 48 pixels"));
}

} // namespace
} // namespace quarn::test
