#include "quarn/farm/FarmStatus.h"
#include "quarn/farm/TaskLog.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::program {
namespace {

using test::TempFolder;
using test::writeFile;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using Stage = FarmTask::Stage;

// ---- Logs

TEST(TaskLog, TellsOfEachStart) {
    const auto attempts = readTaskLog("[quarn farm] 12_7 began on n2: house, frames 0\n"
                                      "[quarn farm] 12_7 began on n1: house, frames 0\n"
                                      "quarn: the document has changed\n"
                                      "[quarn farm] 12_7 ended with 1\n");
    ASSERT_THAT(attempts, SizeIs(2));
    EXPECT_EQ(attempts[0].node, "n2");
    EXPECT_FALSE(attempts[0].exit_code);
    EXPECT_EQ(attempts[1].node, "n1");
    EXPECT_EQ(attempts[1].exit_code, 1);
    EXPECT_EQ(attempts[1].words, "quarn: the document has changed");
}

TEST(TaskLog, TellsWhatSlurmEndedATaskFor) {
    const auto attempts = readTaskLog(
        "[quarn farm] 4_0 began on n1: house, frames 0\n"
        "slurmstepd-n1: error: *** JOB 5 ON n1 CANCELLED AT 2026-11-22T13:54:14 DUE TO PREEMPTION "
        "***\n");
    ASSERT_THAT(attempts, SizeIs(1));
    EXPECT_THAT(attempts[0].words, HasSubstr("PREEMPTION"));
    EXPECT_THAT(readTaskLog("slurmstepd-n1: error: DUE TO NOTHING ***\n"), IsEmpty());
}

// ---- Tasks

class FarmTasks : public testing::Test {
protected:
    FarmTasks() {
        m_record = {.name = "house",
                    .document = "/d/house.quarn",
                    .submitted = "2026-11-22T13:54:14Z",
                    .frames = 8,
                    .chunks = {"0-1", "2-3", "4-5", "6-7"},
                    .arrays = {{"12", 0, 3}, {"13", 3, 1}},
                    .finish_id = "14"};
    }
    std::vector<FarmTask> tasks(const SlurmTelling& slurm, const std::set<int>& missing) const {
        return farmTasks(m_record, m_logs.path(), slurm, missing);
    }
    void writeLog(const std::string& id, const std::string& text) const {
        writeFile(m_logs / (id + ".log"), text);
    }
    static SlurmJob job(const std::string& id, std::vector<int> tasks, const std::string& state,
                        const std::string& node = "") {
        return {
            .id = id, .tasks = std::move(tasks), .state = state, .reason = "None", .node = node};
    }

    FarmRecord m_record;
    TempFolder m_logs;
};

TEST_F(FarmTasks, AreThoseOfAllArraysAndTheLastJob) {
    const auto found = tasks({{job("12", {0, 1}, "PENDING"), job("12", {2}, "RUNNING", "n1"),
                               job("13", {0}, "COMPLETED", "n2"), job("14", {}, "PENDING")},
                              ""},
                             {0, 1, 2, 3, 4, 5});
    ASSERT_THAT(found, SizeIs(5));
    EXPECT_EQ(found[0].id, "12_0");
    EXPECT_EQ(found[0].stage, Stage::waiting);
    EXPECT_EQ(found[2].stage, Stage::running);
    EXPECT_EQ(found[2].node, "n1");
    EXPECT_EQ(found[3].id, "13_0");
    EXPECT_EQ(found[3].frames, "6-7");
    EXPECT_EQ(found[3].stage, Stage::done);
    EXPECT_EQ(found[4].id, "14");
    EXPECT_EQ(found[4].stage, Stage::waiting);
}

TEST_F(FarmTasks, ThatDiedNameTheirNodeAndTheReason) {
    writeLog("12_1", "[quarn farm] 12_1 began on n3: house, frames 0\nquarn: no room is left\n"
                     "[quarn farm] 12_1 ended with 1\n");
    const auto found = tasks(
        {{job("12", {0}, "NODE_FAIL", "n2"), job("12", {1}, "FAILED", "n3")}, ""}, {0, 1, 2, 3});
    EXPECT_EQ(found[0].stage, Stage::died);
    EXPECT_EQ(found[0].node, "n2");
    EXPECT_THAT(found[0].reason, HasSubstr("NODE_FAIL"));
    EXPECT_EQ(found[1].stage, Stage::died);
    EXPECT_THAT(found[1].reason, HasSubstr("no room is left"));
}

TEST_F(FarmTasks, ThatSlurmForgotAreKnownByFramesAndLogs) {
    writeLog("12_1", "[quarn farm] 12_1 began on n3: house, frames 0\n");
    const auto found = tasks({}, {2, 3, 4, 5, 6, 7});
    EXPECT_EQ(found[0].stage, Stage::done); // its frames are there
    EXPECT_EQ(found[1].stage, Stage::died);
    EXPECT_EQ(found[1].node, "n3");
    EXPECT_THAT(found[1].reason, HasSubstr("killed"));
    EXPECT_EQ(found[2].stage, Stage::died);
    EXPECT_THAT(found[2].reason, HasSubstr("never began"));
}

TEST_F(FarmTasks, ThatWereStartedAgainTellHowTheyDiedBefore) {
    writeLog("12_0", "[quarn farm] 12_0 began on n1: house, frames 0\n"
                     "[quarn farm] 12_0 ended with 143\n" // stopped before its time was up
                     "[quarn farm] 12_0 began on n2: house, frames 0\n"
                     "[quarn farm] 12_0 began on n3: house, frames 0\n");
    SlurmJob running = job("12", {0}, "RUNNING", "n3");
    running.restarts = 2;
    const auto found = tasks({{running}, ""}, {0, 1});
    EXPECT_EQ(found[0].stage, Stage::running);
    EXPECT_THAT(found[0].former, ElementsAre(HasSubstr("on n2: ")));
}

TEST_F(FarmTasks, AreNotCalledDeadWhereSlurmDoesNotAnswer) {
    writeLog("12_0", "[quarn farm] 12_0 began on n1: house, frames 0\n");
    const auto found = tasks({{}, "no controller"}, {0, 1, 2, 3, 4, 5, 6, 7});
    EXPECT_EQ(found[0].stage, Stage::running);
    EXPECT_EQ(found[1].stage, Stage::waiting);
}

// ---- What was submitted

TEST_F(FarmTasks, AreReadBackFromWhatWasWritten) {
    const TempFolder folder;
    const FarmFiles files(folder.path(), "house");
    ASSERT_TRUE(writeFarmRecord(files.record, m_record).ok());
    for (const auto& named : {folder.path(), files.record}) {
        const auto read = readFarmRecord(named);
        ASSERT_TRUE(read.ok()) << read.message();
        EXPECT_EQ(read.value().chunks, m_record.chunks);
        EXPECT_THAT(read.value().ids(), ElementsAre("14", "12", "13"));
        EXPECT_EQ(read.value().frames, 8);
        EXPECT_EQ(farmFolder(named), folder.path());
    }
}

TEST_F(FarmTasks, OfADamagedOrMissingFileAreRefusedByName) {
    const TempFolder folder;
    EXPECT_THAT(readFarmRecord(folder.path()).message(), HasSubstr("nothing was submitted"));
    for (const char* const text : {"", "{", "[]", "{\"name\": 3}", "null"}) {
        writeFile(folder / "house.farm.json", text);
        const auto read = readFarmRecord(folder.path());
        ASSERT_FALSE(read.ok()) << text;
        EXPECT_THAT(read.message(), HasSubstr("house.farm.json")) << text;
    }
    writeFile(folder / "tree.farm.json", "");
    EXPECT_THAT(readFarmRecord(folder.path()).message(), HasSubstr("several animations"));
}

// ---- What a person reads

TEST_F(FarmTasks, AreToldByNumbersNodesAndReasons) {
    FarmStatus status{.record = m_record, .recorded = {}};
    status.recorded.progress.frames = 8;
    status.recorded.progress.missing = {2, 3};
    status.recorded.progress.writers = {
        {.host = "a", .pid = 1, .frames = 4, .seconds = 8.0, .trouble = ""},
        {.host = "a", .pid = 2, .frames = 2, .seconds = 4.0, .trouble = ""}};
    status.tasks = {
        {.id = "12_0", .frames = "0-1", .stage = Stage::done},
        {.id = "12_1", .frames = "2-3", .stage = Stage::died, .node = "n2", .reason = "NODE_FAIL"}};
    const std::string text = statusText(status);
    EXPECT_THAT(text, HasSubstr("6 of 8 frames are there, 2 are missing"));
    EXPECT_THAT(text, HasSubstr("a: 6 frames, 2 s a frame"));
    EXPECT_THAT(text, HasSubstr("12_1 (2-3) on n2: NODE_FAIL"));
    EXPECT_THAT(text, HasSubstr("Nothing goes on"));
    EXPECT_EQ(status.framesLost(), 2);
    EXPECT_FALSE(status.isDone() || status.goesOn());

    status.tasks.push_back({.id = "12_2", .frames = "4-5", .stage = Stage::running});
    EXPECT_TRUE(status.goesOn());
    EXPECT_DOUBLE_EQ(status.secondsLeft(), 4.0); // two frames of 2 s, one task at work
    EXPECT_THAT(statusText(status), Not(HasSubstr("Nothing goes on")));
}

TEST_F(FarmTasks, AreNotDoneWhereTheLastJobDied) {
    FarmStatus status{.record = m_record, .recorded = {}};
    status.recorded.progress.is_finished = true;
    status.tasks = {{.id = "14", .frames = "", .stage = Stage::done}};
    EXPECT_TRUE(status.isDone());
    status.tasks.back().stage = Stage::died;
    EXPECT_FALSE(status.isDone());
}

} // namespace
} // namespace quarn::program
