#include "tests/quarn/ProgramRun.h"

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <poll.h>
#include <pty.h>
#include <sstream>
#include <sys/resource.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace quarn::test {

namespace {

constexpr std::chrono::seconds LONGEST_WAIT{60};

void redirect(int descriptor, const std::filesystem::path& file) {
    const int opened = open(file.c_str(), O_CREAT | O_TRUNC | O_WRONLY, 0600);
    dup2(opened, descriptor);
    close(opened);
}

void readFrom(const std::filesystem::path& file) {
    const int opened = open(file.c_str(), O_RDONLY);
    dup2(opened, STDIN_FILENO);
    close(opened);
}

} // namespace

void becomeProgram(const Start& start) {
    if (!start.folder.empty() && chdir(start.folder.c_str()) != 0)
        _exit(126);
    if (start.largest_memory > 0) {
        const rlimit limit = {start.largest_memory, start.largest_memory};
        setrlimit(RLIMIT_AS, &limit);
    }
    if (start.largest_file > 0) {
        const rlimit limit = {start.largest_file, start.largest_file};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    for (const auto& [name, value] : start.environment)
        setenv(name.c_str(), value.c_str(), 1);
    std::vector<char*> words = {const_cast<char*>("quarn")};
    for (const std::string& argument : start.arguments)
        words.push_back(const_cast<char*>(argument.c_str()));
    words.push_back(nullptr);
    execv(start.program.c_str(), words.data());
    _exit(127);
}

RunningProgram::RunningProgram(const Start& start) {
    int terminal = -1;
    if (start.has_terminal && openpty(&m_terminal, &terminal, nullptr, nullptr, nullptr) != 0)
        throw std::runtime_error("cannot open a terminal");
    writeFile(m_output / "in", start.input);
    m_child = fork();
    if (m_child == 0) {
        readFrom(m_output / "in");
        redirect(STDOUT_FILENO, m_output / "out");
        if (start.has_terminal)
            dup2(terminal, STDERR_FILENO);
        else
            redirect(STDERR_FILENO, m_output / "err");
        becomeProgram(start);
    }
    if (terminal >= 0)
        close(terminal);
}

RunningProgram::~RunningProgram() {
    if (!hasEnded()) {
        kill(m_child, SIGKILL);
        waitpid(m_child, &m_status, 0);
    }
    if (m_terminal >= 0)
        close(m_terminal);
}

void RunningProgram::sendSignal(int signal) const {
    kill(m_child, signal);
}

bool RunningProgram::hasEnded() {
    if (!m_has_ended)
        m_has_ended = waitpid(m_child, &m_status, WNOHANG) == m_child;
    return m_has_ended;
}

void RunningProgram::readTerminal() {
    pollfd ready = {m_terminal, POLLIN, 0};
    while (m_terminal >= 0 && poll(&ready, 1, 0) == 1 && (ready.revents & POLLIN)) {
        char bytes[4096];
        const ssize_t count = read(m_terminal, bytes, sizeof bytes);
        if (count <= 0)
            return;
        m_terminal_text.append(bytes, static_cast<std::size_t>(count));
    }
}

bool RunningProgram::waitUntil(const std::function<bool()>& condition) {
    const auto deadline = std::chrono::steady_clock::now() + LONGEST_WAIT;
    while (!condition()) {
        readTerminal();
        if (hasEnded() || std::chrono::steady_clock::now() > deadline)
            return condition();
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
}

Ended RunningProgram::wait() {
    waitUntil([this] { return hasEnded(); });
    readTerminal();
    Ended ended;
    if (m_has_ended && WIFEXITED(m_status))
        ended.exit_code = WEXITSTATUS(m_status);
    if (m_has_ended && WIFSIGNALED(m_status))
        ended.killed_by = WTERMSIG(m_status);
    ended.out = readFile(m_output / "out");
    ended.err = m_terminal >= 0 ? m_terminal_text : readFile(m_output / "err");
    return ended;
}

Ended run(const Start& start) {
    return RunningProgram(start).wait();
}

Ended run(std::vector<std::string> arguments) {
    Start start;
    start.arguments = std::move(arguments);
    return run(start);
}

std::vector<std::string> linesOf(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

} // namespace quarn::test
