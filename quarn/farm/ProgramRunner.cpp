#include "quarn/farm/ProgramRunner.h"

#include "quarn/session/Interruption.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <poll.h>
#include <spawn.h>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace quarn::program {

namespace {

using Clock = std::chrono::steady_clock;

constexpr int LOOK_EVERY_MS = 50; // a person who stops the program is heard that soon
constexpr std::chrono::seconds TIME_TO_END{5};

/// The two ends of a pipe.
class Pipe {
public:
    Pipe() {
        if (pipe2(m_ends.data(), O_CLOEXEC) != 0)
            m_ends = {-1, -1};
    }
    ~Pipe() {
        close(m_ends[0]);
        closeWriter();
    }
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;

    bool isOpen() const { return m_ends[0] >= 0; }
    int reader() const { return m_ends[0]; }
    int writer() const { return m_ends[1]; }
    void closeWriter() {
        if (m_ends[1] >= 0)
            close(m_ends[1]);
        m_ends[1] = -1;
    }

private:
    std::array<int, 2> m_ends{-1, -1};
};

/// What a program is started with: our own input and signals are none of its business.
class StartOptions {
public:
    StartOptions(int out, int err) {
        posix_spawn_file_actions_init(&m_actions);
        posix_spawn_file_actions_addopen(&m_actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_adddup2(&m_actions, out, STDOUT_FILENO);
        posix_spawn_file_actions_adddup2(&m_actions, err, STDERR_FILENO);
        posix_spawnattr_init(&m_attributes);
        sigset_t signals;
        sigfillset(&signals);
        posix_spawnattr_setsigdefault(&m_attributes, &signals);
        sigemptyset(&signals);
        posix_spawnattr_setsigmask(&m_attributes, &signals);
        // A group of its own: Ctrl-C reaches it once, through us.
        posix_spawnattr_setpgroup(&m_attributes, 0);
        posix_spawnattr_setflags(&m_attributes, POSIX_SPAWN_SETSIGDEF | POSIX_SPAWN_SETSIGMASK |
                                                    POSIX_SPAWN_SETPGROUP);
    }
    ~StartOptions() {
        posix_spawnattr_destroy(&m_attributes);
        posix_spawn_file_actions_destroy(&m_actions);
    }
    StartOptions(const StartOptions&) = delete;
    StartOptions& operator=(const StartOptions&) = delete;

    const posix_spawn_file_actions_t* actions() const { return &m_actions; }
    const posix_spawnattr_t* attributes() const { return &m_attributes; }

private:
    posix_spawn_file_actions_t m_actions;
    posix_spawnattr_t m_attributes;
};

/// @return 0, or the number of the error
int start(const std::vector<std::string>& words, const StartOptions& options, pid_t& child) {
    std::vector<char*> arguments;
    for (const std::string& word : words)
        arguments.push_back(const_cast<char*>(word.c_str()));
    arguments.push_back(nullptr);
    return posix_spawnp(&child, arguments[0], options.actions(), options.attributes(),
                        arguments.data(), environ);
}

/// @return false at the end of what is said there
bool readSome(int descriptor, std::string& text) {
    char bytes[65536];
    const ssize_t count = read(descriptor, bytes, sizeof bytes);
    if (count > 0)
        text.append(bytes, static_cast<std::size_t>(count));
    return count > 0 || (count < 0 && errno == EINTR);
}

/// Asks a program to end where it is late or the person stops us, and makes it end where it does
/// not.
class Ending {
public:
    Ending(pid_t child, std::chrono::seconds longest) : m_child(child), m_longest(longest) {}

    void look() {
        const auto now = Clock::now();
        const bool is_late = m_longest.count() > 0 && now > m_start + m_longest;
        if (!m_was_asked && (is_late || isInterruptionRequested())) {
            m_was_asked = true;
            m_is_late = is_late;
            m_asked = now;
            kill(m_child, SIGTERM);
        }
        if (m_is_late && now > m_asked + TIME_TO_END)
            kill(m_child, SIGKILL);
    }
    bool isLate() const { return m_is_late; }

private:
    pid_t m_child;
    std::chrono::seconds m_longest;
    Clock::time_point m_start = Clock::now();
    Clock::time_point m_asked;
    bool m_was_asked = false;
    bool m_is_late = false;
};

void readAll(const Pipe& out, const Pipe& err, Ending& ending, ProgramEnd& end) {
    pollfd waiting[] = {{out.reader(), POLLIN, 0}, {err.reader(), POLLIN, 0}};
    while (waiting[0].fd >= 0 || waiting[1].fd >= 0) {
        poll(waiting, 2, LOOK_EVERY_MS);
        ending.look();
        if (waiting[0].revents && !readSome(waiting[0].fd, end.out))
            waiting[0].fd = -1;
        if (waiting[1].revents && !readSome(waiting[1].fd, end.err))
            waiting[1].fd = -1;
    }
}

} // namespace

ProgramEnd runProgram(const std::vector<std::string>& words, std::chrono::seconds longest) {
    ProgramEnd end;
    Pipe out;
    Pipe err;
    pid_t child = -1;
    const int error = out.isOpen() && err.isOpen()
                          ? start(words, StartOptions(out.writer(), err.writer()), child)
                          : errno;
    if (error != 0) {
        end.is_here = error != ENOENT;
        end.err = words.front() + " cannot be started: " + std::strerror(error);
        return end;
    }
    out.closeWriter();
    err.closeWriter();
    Ending ending(child, longest);
    readAll(out, err, ending, end);
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    end.is_late = ending.isLate();
    if (WIFEXITED(status) && !end.is_late)
        end.exit_code = WEXITSTATUS(status);
    return end;
}

bool isProgramHere(const std::string& name) {
    const char* const path = std::getenv("PATH");
    std::istringstream folders(path ? path : "");
    for (std::string folder; std::getline(folders, folder, ':');)
        if (access((std::filesystem::path(folder) / name).c_str(), X_OK) == 0)
            return true;
    return false;
}

} // namespace quarn::program
