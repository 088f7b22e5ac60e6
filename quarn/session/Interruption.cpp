#include "quarn/session/Interruption.h"

#include <atomic>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

namespace quarn::program {

namespace {

/// The signal that asked the program to stop, 0 while none did, and a pipe that has a byte in it
/// since then, for whoever waits for input. Global, because a signal handler reaches nothing else;
/// atomic, because two signals may reach two threads at once.
std::atomic<int> g_stop_signal = 0;
static_assert(std::atomic<int>::is_always_lock_free);
int g_wake_pipe[2] = {-1, -1};

extern "C" void noteStopSignal(int signal) {
    int none = 0;
    if (!g_stop_signal.compare_exchange_strong(none, signal))
        _exit(128 + signal);
    const int error = errno;
    [[maybe_unused]] const ssize_t written = write(g_wake_pipe[1], "", 1);
    errno = error;
}

void emptyWakePipe() {
    char byte;
    while (read(g_wake_pipe[0], &byte, 1) == 1)
        ;
}

} // namespace

void watchForInterruption() {
    if (g_wake_pipe[0] < 0 && pipe2(g_wake_pipe, O_CLOEXEC | O_NONBLOCK) != 0)
        g_wake_pipe[0] = g_wake_pipe[1] = -1; // poll passes over it
    struct sigaction action = {};
    action.sa_handler = noteStopSignal;
    action.sa_flags = SA_RESTART;
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
    // A terminal that closes; whoever wants the program to outlive it has this signal ignored.
    struct sigaction inherited = {};
    if (sigaction(SIGHUP, nullptr, &inherited) == 0 && inherited.sa_handler != SIG_IGN)
        sigaction(SIGHUP, &action, nullptr);
    std::signal(SIGXFSZ, SIG_IGN);
}

bool isInterruptionRequested() {
    return g_stop_signal != 0;
}

bool forgetCtrlC() {
    if (g_stop_signal != 0 && g_stop_signal != SIGINT)
        return false;
    emptyWakePipe();
    g_stop_signal = 0;
    return true;
}

int interruptionExitCode() {
    return 128 + g_stop_signal;
}

InputByte readInputByte(int descriptor, std::chrono::milliseconds longest) {
    pollfd waiting[] = {{descriptor, POLLIN, 0}, {g_wake_pipe[0], POLLIN, 0}};
    const int ready = poll(waiting, 2, static_cast<int>(longest.count()));
    if (isInterruptionRequested())
        return {InputByte::Kind::interrupted};
    if (ready < 0)
        return {errno == EINTR ? InputByte::Kind::woken : InputByte::Kind::end};
    if (ready == 0)
        return {InputByte::Kind::late};
    InputByte input{InputByte::Kind::byte};
    return read(descriptor, &input.byte, 1) == 1 ? input : InputByte{};
}

} // namespace quarn::program
