// What quarn farm gives to the commands of a cluster, and what its job script makes of it. The
// commands here note their words and do nothing; tests/farm has the same with a cluster.
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

using Words = std::vector<std::string>;

const std::string NOTE_WORDS = "printf '%s\\n' \"${0##*/}\" \"$@\" '' >>\"$CALLS\"\n";

/// A folder with a document of six small frames, and the commands of a cluster that is not there.
class FarmCommand : public testing::Test {
protected:
    FarmCommand() {
        const Ended made = run(m_studio.turntable(6, {"--save", "house", "--out", "whole"}));
        EXPECT_EQ(made.exit_code, 0) << made.err;
        fs::create_directory(m_studio / "bin");
        writeCommand("sbatch", NOTE_WORDS + "echo $((100 + $(grep -c sbatch \"$CALLS\")))\n");
        writeCommand("squeue", NOTE_WORDS);
        writeCommand("scancel", NOTE_WORDS);
        writeCommand("scontrol", NOTE_WORDS + "[ \"$2\" = config ] || { echo 'scontrol: error: "
                                              "Invalid job id specified' >&2; exit 1; }\n"
                                              "echo 'MaxArraySize = 2'\n");
    }

    void writeCommand(const std::string& name, const std::string& text) const {
        const fs::path file = m_studio / "bin" / name;
        writeFile(file, "#!/bin/bash\n" + text);
        fs::permissions(file, fs::perms::owner_all);
    }
    Start farm(Words words) const {
        Start start;
        start.folder = m_studio.path();
        words.insert(words.begin(), "farm");
        start.arguments = std::move(words);
        start.environment = {{"PATH", (m_studio / "bin").native() + ":/usr/bin:/bin"},
                             {"CALLS", (m_studio / "calls").native()}};
        return start;
    }
    Ended submit(Words options = {}, const std::string& out = "out") const {
        options.insert(options.begin(), {"submit", "house.quarn", "--out", out});
        return run(farm(std::move(options)));
    }
    /// The words of each call of a command, in their order.
    std::vector<Words> calls(const std::string& name) const {
        std::vector<Words> found;
        Words call;
        for (const std::string& line : linesOf(readFile(m_studio / "calls"))) {
            if (!line.empty()) {
                call.push_back(line);
                continue;
            }
            if (!call.empty() && call.front() == name)
                found.push_back(call);
            call.clear();
        }
        return found;
    }
    /// Runs the job script as a task of an array does, or as the last job.
    Ended runJob(const fs::path& script, const Words& words, const std::string& task = "") const {
        Start start = farm({});
        start.program = "/bin/bash";
        start.arguments = words;
        start.arguments.insert(start.arguments.begin(), script.native());
        start.environment["SLURM_JOB_ID"] = "7";
        if (!task.empty()) {
            start.environment["SLURM_ARRAY_JOB_ID"] = "7";
            start.environment["SLURM_ARRAY_TASK_ID"] = task;
        }
        return run(start);
    }

    const Studio m_studio;
};

TEST_F(FarmCommand, SubmitsArraysThatTheClusterTakesAndAJobThatFollowsThem) {
    const Ended ended = submit({"--tasks", "3", "--partition", "-fast night", "--time", "1:30:00",
                                "--cpus", "4", "--frame-time", "6.5"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const auto jobs = calls("sbatch");
    ASSERT_THAT(jobs, testing::SizeIs(3)); // three tasks in arrays of two, and the last job
    EXPECT_THAT(jobs[0], Contains("--array=0-1"));
    EXPECT_THAT(jobs[1], Contains("--array=0-0"));
    EXPECT_THAT(jobs[2], Contains("--dependency=afterany:101:102"));
    for (const Words& job : jobs)
        for (const char* const option :
             {"--partition=-fast night", "--time=1:30:00", "--requeue", "--cpus-per-task=4",
              "--signal=B:TERM@7", "--open-mode=append", "--job-name=quarn-house"})
            EXPECT_THAT(job, Contains(option));
    EXPECT_EQ(Words(jobs[1].end() - 2, jobs[1].end()), (Words{"frames", "2"}));
    EXPECT_EQ(jobs[2].back(), "finish");
    const std::string record = readFile(m_studio / "out/house.farm.json");
    for (const char* const id : {"\"101\"", "\"102\"", "\"103\""})
        EXPECT_THAT(record, HasSubstr(id));
}

TEST_F(FarmCommand, MeasuresAFrameAndLeavesNothingOfItBehind) {
    const fs::path passing = m_studio / "passing";
    fs::create_directory(passing);
    Start start = farm({"submit", "house.quarn", "--out", "out"});
    start.environment["TMPDIR"] = passing.native();
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("measured here"));
    EXPECT_THAT(ended.out, HasSubstr("6 frames of 6 are missing: 1 task"));
    EXPECT_TRUE(fs::is_empty(passing));
}

TEST_F(FarmCommand, MakesTheSameFilesByItsScriptAsOneRecording) {
    const std::string out = "it's $(touch pwned) `touch pwned` %a #$HOME; -x";
    ASSERT_EQ(submit({"--tasks", "2", "--retries", "1"}, out).exit_code, 0);
    const fs::path script = m_studio / out / "house.farm.sh";
    for (const char* const task : {"0", "1"}) {
        const Ended made = runJob(script, {"frames", "0"}, task);
        EXPECT_EQ(made.exit_code, 0) << made.out << made.err;
        EXPECT_THAT(made.out, HasSubstr(std::string("[quarn farm] 7_") + task + " ended with 0"));
    }
    const Ended finished = runJob(script, {"finish"});
    EXPECT_EQ(finished.exit_code, 0) << finished.out << finished.err;
    for (const char* const name : {"house000.jpg", "house002.jpg", "house005.jpg", "house.html"})
        EXPECT_TRUE(readFile(m_studio / out / name) == readFile(m_studio / "whole" / name)) << name;
    EXPECT_GT(readFile(m_studio / out / "house005.jpg").size(), 500u);
    EXPECT_FALSE(fs::exists(m_studio / "pwned") || fs::exists(m_studio / out / "pwned"));
}

TEST_F(FarmCommand, StagesTheDocumentOnceANode) {
    const fs::path stage = m_studio / "node's disk";
    ASSERT_EQ(submit({"--tasks", "2", "--stage", stage.native()}).exit_code, 0);
    const fs::path script = m_studio / "out/house.farm.sh";
    ASSERT_EQ(runJob(script, {"frames", "0"}, "0").exit_code, 0);
    const auto staged = [&] {
        Words names;
        for (const auto& entry : fs::recursive_directory_iterator(stage))
            if (entry.path().extension() == ".quarn")
                names.push_back(entry.path().native());
        return names;
    };
    ASSERT_EQ(staged().size(), 1u);
    const std::string copy = staged().front();
    EXPECT_EQ(readFile(copy), readFile(m_studio / "house.quarn"));
    const auto time = fs::last_write_time(copy);
    ASSERT_EQ(runJob(script, {"frames", "0"}, "1").exit_code, 0);
    EXPECT_THAT(staged(), ElementsAre(copy));
    EXPECT_EQ(fs::last_write_time(copy), time);
}

TEST_F(FarmCommand, ReadsTheDocumentWhereItIsWhenItCannotBeStaged) {
    writeFile(m_studio / "file", "");
    ASSERT_EQ(submit({"--tasks", "1", "--stage", (m_studio / "file").native()}).exit_code, 0);
    const Ended made = runJob(m_studio / "out/house.farm.sh", {"frames", "0"}, "0");
    EXPECT_EQ(made.exit_code, 0) << made.out << made.err;
    EXPECT_THAT(made.out, HasSubstr("it is read where it is"));
    EXPECT_TRUE(fs::exists(m_studio / "out/house005.jpg"));
}

TEST_F(FarmCommand, SubmitsWhatIsMissingAlone) {
    ASSERT_EQ(submit({"--tasks", "3"}).exit_code, 0);
    ASSERT_EQ(runJob(m_studio / "out/house.farm.sh", {"frames", "0"}, "1").exit_code, 0);
    const Ended again = submit({"--tasks", "1"});
    ASSERT_EQ(again.exit_code, 0) << again.err;
    EXPECT_THAT(again.out, HasSubstr("4 frames of 6 are missing"));
    EXPECT_THAT(readFile(m_studio / "out/house.farm.sh"), HasSubstr("\n    0-1,4-5\n"));
}

TEST_F(FarmCommand, SubmitsNothingWhereAllIsThere) {
    ASSERT_EQ(run(m_studio.turntable(6)).exit_code, 0);
    const Ended ended = submit();
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("nothing was submitted"));
    EXPECT_THAT(calls("sbatch"), IsEmpty());
}

TEST_F(FarmCommand, PrintsScriptAndCommandsAndDoesNothing) {
    const Ended ended = submit({"--tasks", "3", "--dry-run"}, "it's new");
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, StartsWith("#!/bin/bash\n"));
    EXPECT_FALSE(fs::exists(m_studio / "it's new"));
    EXPECT_THAT(calls("sbatch"), IsEmpty());

    // What is printed may be pasted: the script's own end is left out.
    const std::string commands = ended.out.substr(ended.out.find("\n# ---- This script"));
    writeFile(m_studio / "pasted.sh", commands);
    const Ended pasted = runJob(m_studio / "pasted.sh", {});
    EXPECT_EQ(pasted.exit_code, 0) << pasted.err;
    ASSERT_EQ(submit({"--tasks", "3"}, "it's new").exit_code, 0);
    const auto jobs = calls("sbatch");
    ASSERT_EQ(jobs.size(), 6u);
    EXPECT_EQ(jobs[0], jobs[3]);
    EXPECT_EQ(jobs[1], jobs[4]);
    EXPECT_THAT(jobs[2], Contains("--dependency=afterany:101:102"));
}

TEST_F(FarmCommand, PutsAStoppedTaskBackUnlessSlurmDoesSo) {
    ASSERT_EQ(submit({"--tasks", "1"}).exit_code, 0);
    const fs::path script = m_studio / "out/house.farm.sh";
    std::string text = readFile(script);
    const std::string own = "QUARN=" + fs::canonical(QUARN_PROGRAM).native();
    ASSERT_THAT(text, HasSubstr(own));
    // A recorder that is asked to stop while it draws.
    writeCommand("recorder",
                 "trap 'exit 143' TERM\nkill -TERM $PPID\nwhile :; do sleep 0.05; done\n");
    text.replace(text.find(own), own.size(), "QUARN=" + (m_studio / "bin/recorder").native());
    writeFile(script, text);
    writeCommand("scontrol", NOTE_WORDS + "kill -TERM $PPID; exit 1\n");
    writeCommand("squeue", "echo RUNNING\n");
    const Ended stopped = runJob(script, {"frames", "0"}, "0");
    EXPECT_EQ(stopped.exit_code, 143) << stopped.out << stopped.err;
    EXPECT_THAT(calls("scontrol").back(), ElementsAre("scontrol", "requeue", "7_0"));

    // The recorder has been asked by Slurm itself then.
    writeCommand("recorder",
                 "trap 'touch \"$CALLS.term\"' TERM\nkill -TERM $PPID\nsleep 0.4\nexit 143\n");
    writeCommand("squeue", "echo COMPLETING\n");
    fs::remove(m_studio / "calls");
    EXPECT_EQ(runJob(script, {"frames", "0"}, "0").exit_code, 143);
    EXPECT_THAT(calls("scontrol"), IsEmpty());
    EXPECT_FALSE(fs::exists(m_studio / "calls.term")) << "a second SIGTERM ends it in mid-frame";
}

// ---- Status and cancelling

TEST_F(FarmCommand, TellsHowFarAFolderIsAndCancelsItsJobs) {
    ASSERT_EQ(submit({"--tasks", "3"}).exit_code, 0);
    ASSERT_EQ(runJob(m_studio / "out/house.farm.sh", {"frames", "0"}, "0").exit_code, 0);
    writeCommand("scontrol",
                 "[ \"$2\" = config ] && exit\n"
                 "[ \"$4\" = 101 ] && echo 'JobId=101 ArrayJobId=101 ArrayTaskId=1 "
                 "JobState=RUNNING Reason=None Restarts=0 ExitCode=0:0 NodeList=n1 X=1' && exit\n"
                 "echo 'scontrol: error: Invalid job id specified' >&2; exit 1\n");
    const Ended going = run(farm({"status", "out"}));
    EXPECT_EQ(going.exit_code, 0) << going.err;
    EXPECT_THAT(going.out, HasSubstr("house: 2 of 6 frames are there, 4 are missing."));
    EXPECT_THAT(going.out, HasSubstr("1 task run"));
    EXPECT_THAT(run(farm({"status", "out", "--json"})).out, HasSubstr("\"goes_on\": true"));
    EXPECT_THAT(submit().err, HasSubstr("job 101 still records house"));

    const Ended cancelled = run(farm({"cancel", "out"}));
    EXPECT_EQ(cancelled.exit_code, 0) << cancelled.err;
    EXPECT_THAT(cancelled.out, HasSubstr("2 of 6 frames are there"));
    EXPECT_THAT(calls("scancel"),
                ElementsAre(ElementsAre("scancel", "103"), ElementsAre("scancel", "101"),
                            ElementsAre("scancel", "102")));

    writeCommand("scontrol", "echo 'scontrol: error: Invalid job id specified' >&2; exit 1\n");
    const Ended ended = run(farm({"status", "out"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("Nothing goes on"));
}

TEST_F(FarmCommand, TellsWhatTheFolderHoldsWhereSlurmDoesNotAnswer) {
    ASSERT_EQ(submit({"--tasks", "3"}).exit_code, 0);
    writeCommand("scontrol", "echo 'slurm_load_jobs error: Unable to contact slurm controller "
                             "(connect failure)' >&2; exit 1\n");
    const Ended ended = run(farm({"status", "out"}));
    EXPECT_THAT(ended.err, HasSubstr("Unable to contact slurm controller"));
    EXPECT_THAT(ended.err, HasSubstr("house: no frame was recorded yet."));
}

// ---- Refusals

TEST_F(FarmCommand, PassesOnWhatSlurmRefusesAndCancelsWhatWasSubmittedBefore) {
    writeCommand("sbatch", NOTE_WORDS + "[ $(grep -c sbatch \"$CALLS\") = 1 ] && echo 55 && exit\n"
                                        "echo 'sbatch: error: no more jobs today' >&2; exit 1\n");
    const Ended ended = submit({"--tasks", "1"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_EQ(ended.err, "quarn: sbatch refused the job: no more jobs today\n");
    EXPECT_THAT(calls("scancel"), ElementsAre(ElementsAre("scancel", "55")));
}

TEST_F(FarmCommand, TellsThatSlurmIsNotInstalledBeforeAnythingIsMade) {
    Start start = farm({"submit", "house.quarn", "--out", "out"});
    start.environment["PATH"] = m_studio.path().native();
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, StartsWith("quarn: sbatch is not here; install slurm-client"));
    EXPECT_FALSE(fs::exists(m_studio / "out"));
}

TEST_F(FarmCommand, RefusesAChangedDocumentUnlessItMayOverwrite) {
    ASSERT_EQ(submit({"--tasks", "3"}).exit_code, 0);
    ASSERT_EQ(runJob(m_studio / "out/house.farm.sh", {"frames", "0"}, "0").exit_code, 0);
    ASSERT_EQ(run(m_studio.turntable(6, {"--save", "house", "--out", "tall", "--elevation", "60"}))
                  .exit_code,
              0);
    const Ended refused = submit();
    EXPECT_EQ(refused.exit_code, 1);
    EXPECT_THAT(refused.err, HasSubstr("before it changed"));
    const Ended taken = submit({"--overwrite"});
    EXPECT_EQ(taken.exit_code, 0) << taken.err;
    EXPECT_THAT(taken.out, HasSubstr("6 frames of 6 are missing"));
    EXPECT_TRUE(readFile(m_studio / "out/house000.jpg") ==
                readFile(m_studio / "tall/house000.jpg"));
    const Ended made = runJob(m_studio / "out/house.farm.sh", {"frames", "0"}, "0");
    EXPECT_EQ(made.exit_code, 0) << made.out << made.err;
    EXPECT_TRUE(readFile(m_studio / "out/house005.jpg") ==
                readFile(m_studio / "tall/house005.jpg"));
}

TEST_F(FarmCommand, RefusesWhatMakesNoSense) {
    const std::vector<std::pair<Words, const char*>> mistakes = {
        {{"--tasks", "0"}, "--tasks"},
        {{"--tasks", "2", "--chunk", "2"}, "--chunk"},
        {{"--time", "soon"}, "--time must be a time as Slurm takes it"},
        {{"--stage", "tmp"}, "--stage must be a path from the root"},
        {{"--partition", "a\n#SBATCH --hold"}, "--partition must be a word"},
        {{"--frame-time", "0"}, "--frame-time"},
        {{"--fps", "10"}, "--fps is for a film"},
        {{"--instructions", "mmx"}, "--instructions"}};
    for (const auto& [options, words] : mistakes) {
        const Ended ended = submit(options);
        EXPECT_EQ(ended.exit_code, 2) << options[1];
        EXPECT_THAT(ended.err, HasSubstr(words));
    }
    EXPECT_EQ(submit({"--time", "1", "--frame-time", "40"}).exit_code, 1);
    EXPECT_THAT(submit({"--time", "1", "--frame-time", "40"}).err, HasSubstr("--time gives"));
    EXPECT_EQ(run(farm({})).exit_code, 2);
    EXPECT_THAT(run(farm({"status", "nowhere"})).err, HasSubstr("nothing was submitted for"));
    EXPECT_THAT(calls("sbatch"), IsEmpty());
}

} // namespace
} // namespace quarn::test
