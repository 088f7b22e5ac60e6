#include "host/session/StopSignals.h"

#include <atomic>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <unistd.h>

namespace quarn {

namespace {

/// The signal that asked the program to stop, 0 while none did, and a pipe that has a byte in it
/// since then, for whoever waits for input. Global, because a signal handler reaches nothing else;
/// atomic, because two signals may reach two threads at once.
std::atomic<int> g_stop_signal = 0;
static_assert(std::atomic<int>::is_always_lock_free);
int g_wake_pipe[2] = {-1, -1};
unsigned g_longest_s = 0; ///< as watchForStopSignals was told; set before a signal can come

extern "C" void noteStopSignal(int signal) {
    int none = 0;
    if (!g_stop_signal.compare_exchange_strong(none, signal))
        _exit(128 + signal);
    const int error = errno;
    alarm(g_longest_s);
    [[maybe_unused]] const ssize_t written = write(g_wake_pipe[1], "", 1);
    errno = error;
}

extern "C" void endTheProgram(int) {
    _exit(128 + g_stop_signal);
}

void callAt(int signal, void (*handler)(int)) {
    struct sigaction action = {};
    action.sa_handler = handler;
    action.sa_flags = SA_RESTART;
    sigemptyset(&action.sa_mask);
    sigaction(signal, &action, nullptr);
}

} // namespace

void watchForStopSignals(unsigned longest_s) {
    g_longest_s = longest_s;
    if (longest_s > 0)
        callAt(SIGALRM, endTheProgram);
    if (g_wake_pipe[0] < 0 && pipe2(g_wake_pipe, O_CLOEXEC | O_NONBLOCK) != 0)
        g_wake_pipe[0] = g_wake_pipe[1] = -1; // poll passes over it
    callAt(SIGINT, noteStopSignal);
    callAt(SIGTERM, noteStopSignal);
    // A terminal that closes; whoever wants the program to outlive it has this signal ignored.
    struct sigaction inherited = {};
    if (sigaction(SIGHUP, nullptr, &inherited) == 0 && inherited.sa_handler != SIG_IGN)
        callAt(SIGHUP, noteStopSignal);
    std::signal(SIGXFSZ, SIG_IGN);
}

void allowSecondsToStop(unsigned seconds) {
    if (g_stop_signal != 0 && g_longest_s > 0)
        alarm(seconds);
}

int stopSignal() {
    return g_stop_signal;
}

int stopSignalDescriptor() {
    return g_wake_pipe[0];
}

void forgetStopSignal() {
    char byte;
    while (read(g_wake_pipe[0], &byte, 1) == 1)
        ;
    alarm(0);
    g_stop_signal = 0;
}

} // namespace quarn
