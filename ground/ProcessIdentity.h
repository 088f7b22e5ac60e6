#pragma once

#include <cstdint>
#include <string>

namespace quarn {

/// A running program, told apart from every other one: files that it leaves behind carry this, so
/// that a later one can see whether their writer is still at work.
struct ProcessIdentity {
    std::string host;          ///< name of the machine
    int pid = 0;               ///< of the process on that machine
    std::uint64_t started = 0; ///< when the process began, in clock ticks since the machine's
                               ///< start; 0 where that is not known

    friend bool operator==(const ProcessIdentity&, const ProcessIdentity&) = default;
};

/// The machine's name with nothing in it but what a file name may hold: letters, digits, ".", "_"
/// and "-" stay, all else becomes "_". "localhost" where the machine does not tell.
const std::string& hostName();

/// This process.
ProcessIdentity currentProcess();

/// For how long this process has run, in seconds; 0 where that is not known.
double secondsSinceProcessStart();

/// Whether a process of this machine has ended, or another one has its number now. False for one of
/// another machine: nobody here can tell.
bool hasEnded(const ProcessIdentity& process);

} // namespace quarn
