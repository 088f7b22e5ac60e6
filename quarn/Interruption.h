#pragma once

namespace quarn::program {

/// From now on Ctrl-C (and a request to terminate) is noted instead of ending the program, so that
/// what is being written gets finished. The second one ends the program at once. A file that grows
/// over the size limit of the process becomes an error of the write.
void watchForInterruption();

/// Whether the program was asked to stop.
bool isInterruptionRequested();

/// The exit code of a program that was asked to stop: 128 plus the signal's number.
int interruptionExitCode();

} // namespace quarn::program
