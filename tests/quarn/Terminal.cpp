#include "tests/quarn/Terminal.h"

#include <chrono>
#include <csignal>
#include <poll.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

namespace quarn::test {

namespace {

constexpr int LONGEST_WAIT_MS = 30000;
constexpr char ESCAPE = '\x1b';

/// Whether a control sequence has its last byte: a letter behind "ESC [", or the one byte that
/// follows another escape.
bool isWhole(std::string_view sequence) {
    if (sequence.size() < 2)
        return false;
    if (sequence[1] != '[')
        return true;
    return sequence.size() > 2 && sequence.back() >= '@' && sequence.back() <= '~';
}

} // namespace

Terminal::Terminal(const Start& start, unsigned short columns) {
    const winsize size = {50, columns, 0, 0};
    m_child = forkpty(&m_terminal, nullptr, nullptr, &size);
    if (m_child < 0)
        throw std::runtime_error("cannot open a terminal");
    if (m_child > 0)
        return;
    setenv("TERM", "xterm", 1);
    becomeProgram(start);
}

Terminal::~Terminal() {
    if (m_child > 0) {
        kill(m_child, SIGKILL);
        waitpid(m_child, nullptr, 0);
    }
    if (m_terminal >= 0)
        close(m_terminal);
}

void Terminal::type(std::string_view keys) const {
    while (!keys.empty()) {
        const ssize_t written = write(m_terminal, keys.data(), keys.size());
        if (written <= 0)
            return;
        keys.remove_prefix(static_cast<std::size_t>(written));
    }
}

void Terminal::sendSignal(int signal) const {
    kill(m_child, signal);
}

void Terminal::hangUp() {
    close(m_terminal);
    m_terminal = -1;
}

bool Terminal::shows(std::string_view text) {
    for (;;) {
        const std::size_t found = m_screen.find(text, m_seen);
        if (found != std::string::npos) {
            m_between = m_screen.substr(m_seen, found - m_seen);
            m_seen = found + text.size();
            return true;
        }
        if (!readMore())
            return false;
    }
}

bool Terminal::readMore() {
    pollfd ready = {m_terminal, POLLIN, 0};
    if (poll(&ready, 1, LONGEST_WAIT_MS) != 1) {
        kill(m_child, SIGKILL); // it hangs, or waits for what nobody will type
        return false;
    }
    char bytes[4096];
    const ssize_t count = read(m_terminal, bytes, sizeof bytes);
    if (count <= 0)
        return false; // the program has closed its end
    addToScreen({bytes, static_cast<std::size_t>(count)});
    return true;
}

void Terminal::addToScreen(std::string_view bytes) {
    for (const char byte : bytes) {
        if (m_open_sequence.empty() && byte != ESCAPE) {
            if (byte != '\r')
                m_screen += byte;
            continue;
        }
        m_open_sequence += byte;
        if (isWhole(m_open_sequence))
            m_open_sequence.clear();
    }
}

Ended Terminal::end() {
    while (m_terminal >= 0 && readMore())
        ;
    Ended ended;
    int status = 0;
    if (waitpid(m_child, &status, 0) == m_child && WIFEXITED(status))
        ended.exit_code = WEXITSTATUS(status);
    if (WIFSIGNALED(status))
        ended.killed_by = WTERMSIG(status);
    m_child = -1;
    ended.out = m_screen;
    return ended;
}

} // namespace quarn::test
