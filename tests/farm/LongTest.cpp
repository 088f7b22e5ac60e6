// What takes too long for every run of the tests: `./dev farm-faults`.
#include "tests/farm/FarmFixture.h"

namespace quarn::test {

namespace {

/// Their frames take longer than what each test run can wait for.
class LongFarm : public Farm {};

} // namespace

TEST_F(LongFarm, MakesTwoHundredFramesThoughTwoOfFourNodesAreLostOnTheWay) {
    const House& house = longHouse();
    const Ended submitted = submit(house.document, {"--tasks", "8"});
    ASSERT_EQ(submitted.exit_code, 0) << submitted.err;
    ASSERT_TRUE(waitUntil(300, [&] { return framesIn(m_folder).size() >= 40; })) << logs();
    ASSERT_TRUE(waitUntilDrawing({"n2"}, m_folder)) << logs();
    cluster("kill-node", "n2");
    ASSERT_TRUE(waitUntil(300, [&] { return framesIn(m_folder).size() >= 100; })) << logs();
    ASSERT_TRUE(waitUntilDrawing({"n3"}, m_folder)) << logs();
    cluster("kill-node", "n3");
    ASSERT_TRUE(waitUntilAllJobsEnded(900)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
}

// A controller that is killed forgets the jobs of the last seconds, perhaps the one that finishes.
TEST_F(LongFarm, IsSubmittedAgainWhereTheControllerForgotIt) {
    const House& house = renderedHouse();
    ASSERT_EQ(submit(house.document, {"--tasks", "6"}).exit_code, 0);
    ASSERT_TRUE(waitUntilDrawing(nodes(), m_folder)) << logs();
    cluster("crash-controller");
    EXPECT_TRUE(waitUntil(60, [] {
        return slurm({"squeue", "--noheader", "--states=RUNNING"}).empty();
    })) << slurm({"squeue"});
    bringClusterBack();

    const Ended again = submit(house.document, {"--tasks", "6"});
    ASSERT_EQ(again.exit_code, 0) << again.err;
    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
}

// Limits are whole minutes, and the signal before them comes up to a minute earlier than asked.
TEST_F(LongFarm, ATaskNearItsTimeLimitEndsBetweenFramesAndGoesOnLater) {
    const House& house = longHouse();
    const Ended submitted = submit(house.document, {"--tasks", "2", "--time", "1"});
    ASSERT_EQ(submitted.exit_code, 0) << submitted.err;
    ASSERT_TRUE(
        waitUntil(120,
                  [] {
                      return slurm({"squeue", "--noheader", "--format=%r"}).find("BeginTime") !=
                             std::string::npos;
                  }))
        << slurm({"squeue"}) << logs();
    ASSERT_TRUE(waitUntilAllJobsEnded(1200)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
}

} // namespace quarn::test
