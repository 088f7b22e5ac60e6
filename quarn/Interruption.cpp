#include "quarn/Interruption.h"

#include <csignal>
#include <unistd.h>

namespace quarn::program {

namespace {

/// The signal that asked the program to stop, 0 while none did. Global, because a signal handler
/// reaches nothing else.
volatile std::sig_atomic_t g_stop_signal = 0;

extern "C" void noteStopSignal(int signal) {
    if (g_stop_signal != 0)
        _exit(128 + signal);
    g_stop_signal = signal;
}

} // namespace

void watchForInterruption() {
    struct sigaction action = {};
    action.sa_handler = noteStopSignal;
    action.sa_flags = SA_RESTART;
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
    std::signal(SIGXFSZ, SIG_IGN);
}

bool isInterruptionRequested() {
    return g_stop_signal != 0;
}

int interruptionExitCode() {
    return 128 + g_stop_signal;
}

} // namespace quarn::program
