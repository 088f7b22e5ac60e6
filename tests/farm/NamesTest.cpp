#include "tests/farm/FarmFixture.h"

#include <gmock/gmock.h>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::Not;

/// Arrays on the cluster have at most this many tasks.
constexpr int LARGEST_ARRAY = 9;

} // namespace

TEST_F(Farm, TakesNamesAsTheyAreAndSplitsAnArrayThatIsLargerThanTheClusterAllows) {
    const House& house = quickHouse();
    const fs::path place = m_place / "it's $(touch pwned) `touch pwned` %a %j \\ #$HOME; -x";
    fs::create_directories(place);
    const fs::path document = place / "the house.quarn";
    fs::copy_file(house.document, document);
    m_folder = place / "frames";
    const Ended submitted = submit(document, {"--tasks", std::to_string(LARGEST_ARRAY + 2)});
    ASSERT_EQ(submitted.exit_code, 0) << submitted.err;
    ASSERT_TRUE(waitUntilAllJobsEnded(60)) << slurm({"squeue"}) << logs();
    expectWhatOneProcessMakes(house);
    EXPECT_FALSE(fs::exists(m_place / "pwned") || fs::exists("pwned"));
}

TEST_F(Farm, RefusesPathsThatNoScriptCanHold) {
    for (const char* const name : {"two\nlines", "quoted \" name"}) {
        const fs::path place = m_place / name;
        fs::create_directories(place);
        fs::copy_file(quickHouse().document, place / "house.quarn");
        m_folder = place / "frames";
        const Ended submitted = submit(place / "house.quarn");
        EXPECT_NE(submitted.exit_code, 0) << name;
        EXPECT_THAT(submitted.err, Not(testing::IsEmpty())) << name;
        EXPECT_EQ(slurm({"squeue", "--noheader"}), "") << name;
    }
}

TEST_F(Farm, TellsAPartitionThatIsNotThere) {
    const Ended submitted = submit(quickHouse().document, {"--partition", "nights"});
    EXPECT_EQ(submitted.exit_code, 1);
    EXPECT_THAT(submitted.err, HasSubstr("nights"));
    EXPECT_EQ(slurm({"squeue", "--noheader"}), "");
}

TEST_F(Farm, TakesNoPartOfAScriptForAPartition) {
    for (const char* const partition : {"all\n#SBATCH --hold", "$(touch pwned)", "all --hold"}) {
        const Ended submitted = submit(quickHouse().document, {"--partition", partition});
        EXPECT_NE(submitted.exit_code, 0) << partition;
        EXPECT_EQ(slurm({"squeue", "--noheader"}), "") << partition;
    }
    EXPECT_FALSE(fs::exists("pwned"));
}

TEST_F(Farm, TellsThatSlurmIsNotInstalled) {
    Start start =
        onCluster({"farm", "submit", quickHouse().document.string(), "--out", m_folder.string()});
    start.environment["PATH"] = m_place.path().string();
    const Ended submitted = run(start);
    EXPECT_EQ(submitted.exit_code, 1);
    EXPECT_THAT(submitted.err, HasSubstr("sbatch"));
    EXPECT_FALSE(fs::exists(m_folder)) << "a folder was begun for nothing";
}

TEST_F(Farm, PrintsWhatItWouldDoAndDoesNothing) {
    const Ended printed = submit(quickHouse().document, {"--dry-run", "--tasks", "3"});
    EXPECT_EQ(printed.exit_code, 0) << printed.err;
    EXPECT_THAT(printed.out, HasSubstr("#!/bin/bash"));
    EXPECT_THAT(printed.out, HasSubstr("sbatch"));
    EXPECT_EQ(slurm({"squeue", "--noheader"}), "");
    EXPECT_FALSE(fs::exists(m_folder));
}

} // namespace quarn::test
