#pragma once

#include <chrono>
#include <string>
#include <vector>

namespace quarn::program {

/// How a program that was run ended, and what it said.
struct ProgramEnd {
    bool is_here = true;  ///< false: there is no such program, and nothing was run
    bool is_late = false; ///< it took longer than it was given, and was ended
    int exit_code = -1;   ///< -1 where it has none: a signal ended it, or it never began
    std::string out;
    std::string err;

    bool ok() const { return exit_code == 0; }
};

/// Runs a program to its end, with these words and no shell between; nothing stands in its standard
/// input. A request to stop this program is passed on to it as SIGTERM.
/// @param words    the program first: a path, or a name that is looked for in PATH
/// @param longest  it may take; zero: as long as it wants
ProgramEnd runProgram(const std::vector<std::string>& words,
                      std::chrono::seconds longest = std::chrono::seconds(0));

/// Whether PATH holds a program of this name.
bool isProgramHere(const std::string& name);

} // namespace quarn::program
