#pragma once

#include "tests/support/TempFolder.h"

#include <functional>
#include <map>
#include <string>
#include <sys/types.h>
#include <vector>

namespace quarn::test {

/// How the program is started.
struct Start {
    std::vector<std::string> arguments;
    std::filesystem::path folder;                   ///< to run in; empty: the test's own
    std::map<std::string, std::string> environment; ///< on top of the test's own
    std::string input;                              ///< what its standard input holds
    unsigned long largest_file = 0;                 ///< bytes; 0: no limit
    unsigned long largest_memory = 0;               ///< bytes of addresses; 0: no limit
    bool has_terminal = false;                      ///< its standard error is a terminal
    std::filesystem::path program = QUARN_PROGRAM;
};

/// Makes a process that was just forked the program. Never returns.
[[noreturn]] void becomeProgram(const Start& start);

/// How the program ended.
struct Ended {
    int exit_code = -1; ///< -1 when a signal killed it
    int killed_by = 0;  ///< the signal
    std::string out;
    std::string err;
};

/// The built program while it runs.
class RunningProgram {
public:
    explicit RunningProgram(const Start& start);
    ~RunningProgram();
    RunningProgram(const RunningProgram&) = delete;
    RunningProgram& operator=(const RunningProgram&) = delete;

    pid_t id() const { return m_child; }
    void sendSignal(int signal) const;
    /// Waits until the condition holds, at most a minute.
    /// @return false when the program ended, or the minute passed, before it did
    bool waitUntil(const std::function<bool()>& condition);
    Ended wait();

private:
    void startChild(const Start& start);
    bool hasEnded();
    void readTerminal();

    TempFolder m_output;
    pid_t m_child = -1;
    int m_status = 0;
    bool m_has_ended = false;
    int m_terminal = -1;
    std::string m_terminal_text;
};

Ended run(const Start& start);
Ended run(std::vector<std::string> arguments);

/// The lines of a text.
std::vector<std::string> linesOf(const std::string& text);

} // namespace quarn::test
