#include "quarn/session/Interruption.h"

#include "host/session/StopSignals.h"

#include <cerrno>
#include <csignal>
#include <poll.h>
#include <unistd.h>

namespace quarn::program {

void watchForInterruption() {
    watchForStopSignals();
}

bool isInterruptionRequested() {
    return stopSignal() != 0;
}

bool forgetCtrlC() {
    if (stopSignal() != 0 && stopSignal() != SIGINT)
        return false;
    forgetStopSignal();
    return true;
}

int interruptionSignal() {
    return stopSignal();
}

int interruptionExitCode() {
    return 128 + stopSignal();
}

InputByte readInputByte(int descriptor, std::chrono::milliseconds longest) {
    pollfd waiting[] = {{descriptor, POLLIN, 0}, {stopSignalDescriptor(), POLLIN, 0}};
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
