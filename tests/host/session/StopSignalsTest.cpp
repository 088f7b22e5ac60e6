#include "host/session/StopSignals.h"

#include <gtest/gtest.h>

#include <csignal>
#include <poll.h>
#include <unistd.h>

namespace quarn {
namespace {

// Each of them has a process of its own, so that the tests keep their way with signals.

[[noreturn]] void hang() {
    for (;;)
        pause();
}

bool canBeRead(int descriptor) {
    pollfd ready = {descriptor, POLLIN, 0};
    return poll(&ready, 1, 0) == 1;
}

TEST(StopSignals, TheFirstIsNotedAndWakesWhoeverWaits) {
    const auto note = [] {
        watchForStopSignals();
        if (stopSignal() != 0 || canBeRead(stopSignalDescriptor()))
            _exit(1);
        raise(SIGTERM);
        _exit(stopSignal() == SIGTERM && canBeRead(stopSignalDescriptor()) ? 0 : 2);
    };
    EXPECT_EXIT(note(), testing::ExitedWithCode(0), "");
}

TEST(StopSignals, TheSecondEndsTheProgramAtOnce) {
    const auto stop_twice = [] {
        watchForStopSignals();
        raise(SIGHUP);
        raise(SIGTERM);
        _exit(0);
    };
    EXPECT_EXIT(stop_twice(), testing::ExitedWithCode(128 + SIGTERM), "");
}

/// It may take a minute, and later has a second left.
TEST(StopSignals, AProgramThatHangsIsEndedWhenItsTimeIsOver) {
    const auto stop_and_hang = [] {
        watchForStopSignals(60);
        raise(SIGINT);
        if (alarm(60) == 0)
            _exit(1);
        allowSecondsToStop(1);
        hang();
    };
    EXPECT_EXIT(stop_and_hang(), testing::ExitedWithCode(128 + SIGINT), "");
}

TEST(StopSignals, NobodyIsEndedWhoWasNotAskedToStop) {
    const auto go_on = [] {
        watchForStopSignals(60);
        allowSecondsToStop(60);
        _exit(alarm(0) == 0 ? 0 : 1);
    };
    EXPECT_EXIT(go_on(), testing::ExitedWithCode(0), "");
}

TEST(StopSignals, AForgottenOneCanComeAgain) {
    const auto stop_again = [] {
        watchForStopSignals(60);
        raise(SIGINT);
        forgetStopSignal();
        if (stopSignal() != 0 || canBeRead(stopSignalDescriptor()) || alarm(0) != 0)
            _exit(1);
        raise(SIGTERM);
        _exit(stopSignal() == SIGTERM ? 0 : 2);
    };
    EXPECT_EXIT(stop_again(), testing::ExitedWithCode(0), "");
}

} // namespace
} // namespace quarn
