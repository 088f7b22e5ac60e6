#include "tests/desktop_kills/TypedWork.h"

#include <gtest/gtest.h>

#include <csignal>

namespace quarn::test {
namespace {

/// A beat that never comes while a test runs: what is kept then is kept at the end.
const std::vector<std::string> NO_BEAT = {"--recovery-every", "3600"};

class StoppedWindow : public testing::TestWithParam<int> {};

TEST_P(StoppedWindow, KeepsItsUnsavedWorkForTheNextStart) {
    TypedWork work;
    work.begin(NO_BEAT);
    const int done = work.doneUntil(TypedWork::Clock::now());
    const Ended ended = work.stop(GetParam());
    EXPECT_EQ(ended.exit_code, 128 + GetParam()) << ended.err;
    EXPECT_EQ(readFile(work.file()), readFile(work.savedCopy()));
    EXPECT_EQ(work.recover(NO_BEAT).exit_code, 0);
    EXPECT_TRUE(work.wasOffered());
    EXPECT_GE(objectsIn(work.recovered()), done);
}

INSTANTIATE_TEST_SUITE_P(Stop, StoppedWindow, testing::Values(SIGTERM, SIGINT, SIGHUP));

TEST(StoppedWindow, KeepsNothingWhereRecoveryIsNotWanted) {
    TypedWork work;
    work.begin({"--no-recovery"});
    EXPECT_EQ(work.stop(SIGTERM).exit_code, 128 + SIGTERM);
    EXPECT_EQ(work.recover(NO_BEAT).exit_code, 0);
    EXPECT_FALSE(work.wasOffered());
}

} // namespace
} // namespace quarn::test
