#pragma once

#include <string>

namespace quarn::program {

/// How a run of the program ended: the code that the shell sees, and what a person is told.
struct Outcome {
    static constexpr int done = 0;
    static constexpr int failed = 1;
    static constexpr int misused = 2; ///< the arguments make no sense; nothing was run

    int exit_code = done;
    /// UTF-8; goes to the standard output when all went well, else to the standard error.
    std::string text;

    static Outcome success(std::string text) { return {done, std::move(text)}; }
    static Outcome failure(const std::string& message) { return {failed, "quarn: " + message}; }
    static Outcome misuse(const std::string& message) { return {misused, "quarn: " + message}; }
};

} // namespace quarn::program
