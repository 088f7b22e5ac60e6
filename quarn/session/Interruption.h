#pragma once

#include <chrono>

namespace quarn::program {

/// From now on Ctrl-C, a request to terminate and the end of the terminal are noted instead of
/// ending the program, so that what is being written gets finished. The second one ends the program
/// at once. A file that grows over the size limit of the process becomes an error of the write.
void watchForInterruption();

/// Whether the program was asked to stop.
bool isInterruptionRequested();

/// Forgets a Ctrl-C that stopped what it was meant to stop, so that the program goes on and the
/// next one is the first again.
/// @return false when the program was asked to terminate, or lost its terminal; that is not
///   forgotten
bool forgetCtrlC();

/// The number of the signal that asked the program to stop; 0 while none did.
int interruptionSignal();

/// The exit code of a program that was asked to stop: 128 plus the signal's number.
int interruptionExitCode();

/// A byte of input, or why there is none.
struct InputByte {
    enum class Kind {
        byte,
        end,         ///< nothing more will come
        interrupted, ///< the program was asked to stop
        woken,       ///< another signal came while nothing was typed
        late,        ///< nothing was typed in time
    };
    Kind kind = Kind::end;
    unsigned char byte = 0;
};

/// Waiting without an end.
inline constexpr std::chrono::milliseconds NO_END{-1};

/// Waits for a byte of a file descriptor, or for a request to stop, whichever comes first. Needs
/// watchForInterruption.
/// @param longest  of the wait, or NO_END
InputByte readInputByte(int descriptor, std::chrono::milliseconds longest = NO_END);

} // namespace quarn::program
