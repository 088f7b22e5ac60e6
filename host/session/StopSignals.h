#pragma once

#include "sdk/qncore/QnExport.h"

namespace quarn {

/// From now on Ctrl-C, a request to terminate and the end of the terminal are noted instead of
/// ending the program, so that it can end in order. The second one ends the program at once, with
/// 128 plus its number. A file that grows over the size limit of the process becomes an error of
/// the write.
/// @param longest_s  a program that has not ended so many seconds after the first signal, because
///                   it hangs, is ended as by a second one; 0: it is waited for
QNCORE_API void watchForStopSignals(unsigned longest_s = 0);

/// Gives a program that was asked to stop so many seconds from now, where it has something to do
/// that may take longer than what it was given. Without such a signal it does nothing.
QNCORE_API void allowSecondsToStop(unsigned seconds);

/// The number of the signal that asked the program to stop; 0 while none did.
QNCORE_API int stopSignal();

/// A descriptor that can be read from once a signal came, for whoever waits for several things at
/// once; -1 where the system has none to give. Nobody but forgetStopSignal reads from it.
QNCORE_API int stopSignalDescriptor();

/// Forgets the signal that came, so that the next one is the first again.
QNCORE_API void forgetStopSignal();

} // namespace quarn
