#include "ground/ProcessIdentity.h"

#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

using namespace quarn;

namespace {

/// A process that has ended and was waited for.
int endedProcess() {
    const int pid = fork();
    if (pid == 0)
        _exit(0);
    int status = 0;
    EXPECT_EQ(waitpid(pid, &status, 0), pid);
    return pid;
}

} // namespace

TEST(ProcessIdentity, ThisProcessHasNotEnded) {
    const ProcessIdentity here = currentProcess();
    EXPECT_EQ(here.pid, getpid());
    EXPECT_FALSE(here.host.empty());
    EXPECT_GT(here.started, 0U);
    EXPECT_FALSE(hasEnded(here));
    EXPECT_EQ(here, currentProcess());
}

TEST(ProcessIdentity, OneThatWasWaitedForHasEnded) {
    EXPECT_TRUE(hasEnded({hostName(), endedProcess(), 0}));
}

TEST(ProcessIdentity, ANumberThatWasGivenToALaterProcessMeansTheFirstHasEnded) {
    ProcessIdentity earlier = currentProcess();
    earlier.started -= 1;
    EXPECT_TRUE(hasEnded(earlier));
}

TEST(ProcessIdentity, NobodyHereTellsOfAnotherMachinesProcesses) {
    EXPECT_FALSE(hasEnded({hostName() + "-other", endedProcess(), 0}));
}

TEST(ProcessIdentity, TheMachinesNameFitsIntoAFileName) {
    EXPECT_EQ(hostName().find_first_not_of("abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
                                           "0123456789._-"),
              std::string::npos);
}
