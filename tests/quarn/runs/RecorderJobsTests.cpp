#include "quarn/runs/FolderInstructions.h"
#include "quarn/runs/OtherRecorders.h"
#include "quarn/runs/RecorderJobs.h"
#include "tests/quarn/Terminal.h"
#include "tests/quarn/runs/RecordedDocument.h"

#include <csignal>
#include <gmock/gmock.h>
#include <iterator>
#include <sstream>
#include <thread>

namespace quarn::test {
namespace {

using namespace std::chrono_literals;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using testing::SizeIs;

constexpr int FRAMES = 60;

class RecorderJobs : public testing::Test {
protected:
    /// The processes that a process has started.
    static std::vector<pid_t> childrenOf(pid_t parent) {
        const std::string id = std::to_string(parent);
        std::istringstream text(readFile("/proc/" + id + "/task/" + id + "/children"));
        return {std::istream_iterator<pid_t>(text), {}};
    }

    const RecordedDocument house{FRAMES, "320 240"};
};

TEST_F(RecorderJobs, MakeTheSameAsOneProgram) {
    ASSERT_EQ(run(house.record("whole")).exit_code, 0);
    const Ended ended = run(house.record("out", {"--jobs", "2"}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_THAT(ended.out, MatchesRegex("60 frames and out/house.html in [0-9.]+ s\n"));
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
}

TEST_F(RecorderJobs, MakePartsAndKeepWhatIsThere) {
    ASSERT_EQ(run(house.record("out", {"--frames", "0-9"})).exit_code, 0);
    const Ended ended = run(house.record("out", {"--jobs", "2", "--frames", "5-24"}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, MatchesRegex("20 frames of house in out in [0-9.]+ s \\(5 of them were "
                                        "there already\\); quarn finish out .*\n"));
    EXPECT_EQ(house.picturesIn("out"), 25);
    EXPECT_FALSE(std::filesystem::exists(house / "out/house.html"));
}

TEST_F(RecorderJobs, MakeAllAnewWhereThatIsAskedFor) {
    ASSERT_EQ(run(house.record("out", {"--quality", "30"})).exit_code, 0);
    const Ended ended = run(house.record("out", {"--jobs", "2", "--overwrite"}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, Not(HasSubstr("already")));
    ASSERT_EQ(run(house.record("whole")).exit_code, 0);
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
}

TEST_F(RecorderJobs, ThatOneOfDiesAreToldOfAndItsFramesMade) {
    RunningProgram program(house.record("out", {"--jobs", "2"}));
    std::vector<pid_t> recorders;
    ASSERT_TRUE(program.waitUntil([&] {
        recorders = childrenOf(program.id());
        return recorders.size() == 2 && house.picturesIn("out") >= 3;
    }));
    kill(recorders[1], SIGKILL);
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err,
                HasSubstr("quarn: recorder 2 of 2 (process " + std::to_string(recorders[1]) +
                          ") was ended by the signal 9 (Killed)"));
    ASSERT_EQ(run(house.record("whole")).exit_code, 0);
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
}

TEST_F(RecorderJobs, EndWithTheProgramThatAPersonStops) {
    RunningProgram program(house.record("out", {"--jobs", "2"}));
    std::vector<pid_t> recorders;
    ASSERT_TRUE(program.waitUntil([&] {
        recorders = childrenOf(program.id());
        return recorders.size() == 2 && house.picturesIn("out") >= 3;
    }));
    program.sendSignal(SIGINT);
    const Ended ended = program.wait();
    EXPECT_EQ(ended.exit_code, 130);
    EXPECT_THAT(ended.err,
                MatchesRegex("Stopped after [0-9]+ of 60 frames\\. The same command goes "
                             "on where it stopped\\.\n"));
    for (const pid_t recorder : recorders)
        EXPECT_NE(kill(recorder, 0), 0) << "recorder " << recorder << " still runs";
    const int made = house.picturesIn("out");
    EXPECT_THAT(ended.err, HasSubstr("after " + std::to_string(made) + " of"));
    const Ended again = run(house.record("out", {"--jobs", "2"}));
    EXPECT_THAT(again.out, HasSubstr("(" + std::to_string(made) + " of them were there already)"));
}

/// The terminal sends Ctrl-C to the whole group of processes: recorders are in groups of their own,
/// and what ends them is the one signal that is passed on.
TEST_F(RecorderJobs, EndTheirFramesAtACtrlCOnATerminal) {
    house.save("house.quarn", FRAMES, "3000 2000"); // frames that take longer than the passing on
    Terminal terminal(house.record("out", {"--jobs", "2"}));
    ASSERT_TRUE(terminal.shows("of 60"));
    terminal.type(CTRL_C);
    const Ended ended = terminal.end();
    EXPECT_EQ(ended.exit_code, 130);
    EXPECT_THAT(terminal.screen(), HasSubstr("The same command goes on where it stopped."));
    for (const std::string& name : filesIn(house / "out"))
        EXPECT_FALSE(name.ends_with(".claim")) << name;
}

TEST_F(RecorderJobs, OnATerminalShowOneLineOfAll) {
    Start start = house.record("out", {"--jobs", "2"});
    start.has_terminal = true;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("of 60"));
}

TEST_F(RecorderJobs, TellOnceWhatAllRefuse) {
    writeFile(house / "house.quarn", "no document");
    const Ended ended = run(house.record("out", {"--jobs", "3"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("house.quarn"));
}

TEST_F(RecorderJobs, MoreThanThereAreCoresAreToldOf) {
    const int cores = static_cast<int>(std::thread::hardware_concurrency());
    const Ended ended =
        run(house.record("out", {"--frames", "0-3", "--jobs", std::to_string(cores + 1)}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr(std::to_string(cores + 1) + " recorders share "));
}

// ---- Their parts

TEST(Recorders, HaveTheirShareOfTheCoresAndAtLeastOneThread) {
    EXPECT_EQ(program::threadsOfEach(4, 0, 64), 16);
    EXPECT_EQ(program::threadsOfEach(3, 0, 8), 2);
    EXPECT_EQ(program::threadsOfEach(8, 0, 2), 1);
    EXPECT_EQ(program::threadsOfEach(2, 12, 64), 6);
}

TEST(Recorders, GetOneWordForEachThingWhateverItHolds) {
    program::DocumentRecordingRequest request;
    request.document = "--a $(b) 'c'.quarn";
    request.folder = "-d e";
    request.part = program::FrameRanges({{0, 9, 2}});
    request.quality = 75;
    program::CommonOptions common;
    common.instructions = "sse2";
    EXPECT_THAT(program::recorderArguments(request, common, 3, false),
                ElementsAre("record", "./--a $(b) 'c'.quarn", "--recorder=same", "--out=-d e",
                            "--threads=3", "--frames=0-9:2", "--quality=75",
                            "--instructions=sse2"));
    common.overwrites = true;
    EXPECT_THAT(program::recorderArguments(request, common, 3, true),
                testing::AllOf(Contains("--recorder=anew"), Contains("--overwrite")));
}

RecordingWriter writerOn(const std::string& host, int frames, double seconds, bool is_alive) {
    RecordingWriter writer;
    writer.host = host;
    writer.frames = frames;
    writer.seconds = seconds;
    writer.is_alive = is_alive;
    return writer;
}

TEST(OtherRecorders, AreNamedByTheirLivingHosts) {
    RecordingProgress progress;
    EXPECT_EQ(program::livingHostsText(progress), "");
    progress.writers = {writerOn("node2", 1, 1, true), writerOn("node1", 1, 1, true),
                        writerOn("node2", 1, 1, true), writerOn("node9", 1, 1, false)};
    EXPECT_EQ(program::livingHostsText(progress), "node1 and node2");
}

TEST(OtherRecorders, AreWaitedForLongerThanALeaseAndThanSlowFrames) {
    RecordingProgress progress;
    EXPECT_EQ(program::patienceWith(progress), 75s);
    progress.writers = {writerOn("a", 10, 20, true), writerOn("b", 0, 0, true)};
    EXPECT_EQ(program::patienceWith(progress), 75s);
    progress.writers.push_back(writerOn("c", 2, 600, true));
    EXPECT_EQ(program::patienceWith(progress), 1200s);
}

TEST(FolderInstructions, ThatThisProcessorLacksAreToldWithThoseThatItHas) {
    EXPECT_EQ(program::whyInstructionsLack("out", "avx512", {"avx2", "sse2"}),
              "the recording in out is drawn with the instructions avx512, and this processor has "
              "avx2, sse2: pictures of it would differ in a few pixels. Record on a machine that "
              "has avx512, or begin anew with quarn record ... --overwrite.");
    EXPECT_EQ(program::whyInstructionsLack("out", "sse2", {"avx2", "sse2"}), std::nullopt);
    EXPECT_EQ(program::whyInstructionsLack("out", "", {"sse2"}), std::nullopt);
}

} // namespace
} // namespace quarn::test
