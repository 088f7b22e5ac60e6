#pragma once

#include "tests/quarn/ProgramRun.h"

#include <string>
#include <string_view>

namespace quarn::test {

inline constexpr const char* CTRL_C = "\x03";
inline constexpr const char* CTRL_D = "\x04";
inline constexpr const char* TAB = "\t";
inline constexpr const char* UP = "\x1b[A";

/// The program at a terminal of its own, and a person in front of it.
class Terminal {
public:
    /// @param columns  the width of the terminal
    explicit Terminal(const Start& start, unsigned short columns = 200);
    ~Terminal();
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    /// Presses keys.
    void type(std::string_view keys) const;
    void sendSignal(int signal) const;
    /// Closes the terminal under the program; nothing is typed and seen any more.
    void hangUp();
    /// Waits, at most half a minute, until the terminal shows the text behind the one waited for
    /// last.
    /// @return false when the program ended, or the time passed, before it did
    bool shows(std::string_view text);
    /// What the terminal shows between the last two texts that were waited for.
    const std::string& between() const { return m_between; }
    /// Everything shown so far, without what moves the cursor about.
    const std::string& screen() const { return m_screen; }
    /// Waits, at most half a minute, for the end of the program.
    Ended end();

private:
    bool readMore();
    void addToScreen(std::string_view bytes);

    pid_t m_child = -1;
    int m_terminal = -1;
    std::string m_open_sequence;
    std::string m_screen;
    std::size_t m_seen = 0;
    std::string m_between;
};

} // namespace quarn::test
