// The texts are those that Slurm 22.05 printed.
#include "quarn/farm/SlurmText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::program {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

const std::string TWO_TASKS =
    "JobId=19 ArrayJobId=19 ArrayTaskId=1-4%1 ArrayTaskThrottle=1 JobName=wrap UserId=root(0) "
    "GroupId=root(0) MCS_label=N/A Priority=4294901746 Nice=0 Account=(null) QOS=(null) "
    "JobState=PENDING Reason=JobArrayTaskLimit Dependency=(null) Requeue=1 Restarts=0 BatchFlag=1 "
    "Reboot=0 ExitCode=0:0 RunTime=00:00:00 TimeLimit=01:00:00 NodeList= NumNodes=1\n"
    "JobId=3 ArrayJobId=1 ArrayTaskId=0 JobName=a.sh UserId=root(0) GroupId=root(0) MCS_label=N/A "
    "Priority=4294901759 Nice=0 Account=(null) QOS=(null) JobState=FAILED Reason=NonZeroExitCode "
    "Dependency=(null) Requeue=1 Restarts=2 BatchFlag=1 Reboot=0 ExitCode=9:0 RunTime=00:00:05 "
    "ReqNodeList=(null) ExcNodeList=(null) NodeList=n1 BatchHost=n1 NumNodes=1 "
    "Command=/x/a.sh WorkDir=/x StdErr=/x/lim-0.log StdIn=/dev/null StdOut=/x/lim-0.log Power= \n";

TEST(SlurmJobs, AreReadFromWhatTheControllerShows) {
    const auto jobs = readJobs(TWO_TASKS);
    ASSERT_THAT(jobs, SizeIs(2));
    EXPECT_EQ(jobs[0].id, "19");
    EXPECT_THAT(jobs[0].tasks, ElementsAre(1, 2, 3, 4));
    EXPECT_EQ(jobs[0].state, "PENDING");
    EXPECT_EQ(jobs[0].reason, "JobArrayTaskLimit");
    EXPECT_EQ(jobs[0].node, "");
    EXPECT_EQ(jobs[1].id, "1"); // of the array, not of the task
    EXPECT_THAT(jobs[1].tasks, ElementsAre(0));
    EXPECT_EQ(jobs[1].state, "FAILED");
    EXPECT_EQ(jobs[1].node, "n1");
    EXPECT_EQ(jobs[1].exit_code, "9:0");
    EXPECT_EQ(jobs[1].restarts, 2);
}

TEST(SlurmJobs, AreNotForgedByThePathsBehindThem) {
    const auto jobs = readJobs("JobId=5 JobName=a JobState=RUNNING Reason=None NodeList=n1 "
                               "WorkDir=/x JobState=FAILED NodeList=n9/y\n");
    ASSERT_THAT(jobs, SizeIs(1));
    EXPECT_EQ(jobs[0].state, "RUNNING");
    EXPECT_EQ(jobs[0].node, "n1");
    EXPECT_THAT(jobs[0].tasks, IsEmpty());
}

TEST(SlurmJobs, LiveUntilTheirStateIsALastOne) {
    for (const char* const state : {"PENDING", "RUNNING", "COMPLETING", "REQUEUED", "SUSPENDED"}) {
        const SlurmJob job{.id = "1", .tasks = {}, .state = state};
        EXPECT_TRUE(job.isLive()) << state;
        EXPECT_FALSE(job.hasDied()) << state;
    }
    for (const char* const state : {"FAILED", "NODE_FAIL", "TIMEOUT", "OUT_OF_MEMORY"}) {
        const SlurmJob job{.id = "1", .tasks = {}, .state = state};
        EXPECT_FALSE(job.isLive()) << state;
        EXPECT_TRUE(job.hasDied()) << state;
    }
    const SlurmJob cancelled{.id = "1", .tasks = {}, .state = "CANCELLED"};
    EXPECT_FALSE(cancelled.isLive() || cancelled.hasDied());
}

TEST(SlurmAccounts, AreReadWhereThereAreSome) {
    const auto jobs = readAccounts("12_7|NODE_FAIL|0:0|n2\n12_8|CANCELLED by 1000|0:15|n1\n"
                                   "13|COMPLETED|0:0|None assigned\n");
    ASSERT_THAT(jobs, SizeIs(3));
    EXPECT_EQ(jobs[0].id, "12");
    EXPECT_THAT(jobs[0].tasks, ElementsAre(7));
    EXPECT_EQ(jobs[0].node, "n2");
    EXPECT_EQ(jobs[1].state, "CANCELLED");
    EXPECT_EQ(jobs[2].node, "");
    EXPECT_THAT(readAccounts("Slurm accounting storage is disabled\n"), IsEmpty());
}

TEST(SlurmLimits, AreReadFromTheConfiguration) {
    const SlurmLimits limits = readLimits("MaxArraySize            = 41\n"
                                          "MaxDBDMsgs              = 20012\n"
                                          "MaxJobCount             = 10000\n");
    EXPECT_EQ(limits.array_size, 41);
    EXPECT_EQ(limits.jobs, 10000);
}

TEST(SlurmRefusals, ArePassedOnInTheirOwnWords) {
    EXPECT_EQ(refusalText("sbatch: error: invalid partition specified: nope\n"
                          "sbatch: error: Batch job submission failed: Invalid partition name "
                          "specified\n"),
              "invalid partition specified: nope; Invalid partition name specified");
    EXPECT_EQ(refusalText("slurm_load_jobs error: Invalid job id specified\n"),
              "Invalid job id specified");
    EXPECT_EQ(refusalText(""), "");
}

TEST(SlurmTimes, AreCountedInWholeMinutes) {
    EXPECT_EQ(limitSeconds("90"), 5400.0);
    EXPECT_EQ(limitSeconds("1:30"), 120.0);
    EXPECT_EQ(limitSeconds("1:30:00"), 5400.0);
    EXPECT_EQ(limitSeconds("2-12"), 216000.0);
    EXPECT_EQ(limitSeconds("1-6:30"), 109800.0);
    EXPECT_EQ(limitSeconds("1-0:0:1"), 86460.0);
    for (const char* const wrong :
         {"", "0", "x", "-5", "1:2:3:4", "1-", "1:", ":1", "1 2", "--x", "1-2-3", "$(x)"})
        EXPECT_FALSE(limitSeconds(wrong)) << wrong;
}

} // namespace
} // namespace quarn::program
