#include "quarn/runs/RecorderProcess.h"

#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace quarn::program {

namespace {

/// As long as the file that this program was started from is the one that runs, whatever has come
/// to stand under its name since.
constexpr const char* THIS_PROGRAM = "/proc/self/exe";
constexpr const char* NOWHERE = "/dev/null";

class FileActions {
public:
    FileActions() { posix_spawn_file_actions_init(&m_actions); }
    ~FileActions() { posix_spawn_file_actions_destroy(&m_actions); }
    FileActions(const FileActions&) = delete;
    FileActions& operator=(const FileActions&) = delete;

    bool redirect(int errors) {
        return posix_spawn_file_actions_addopen(&m_actions, STDIN_FILENO, NOWHERE, O_RDONLY, 0) ==
                   0 &&
               posix_spawn_file_actions_addopen(&m_actions, STDOUT_FILENO, NOWHERE, O_WRONLY, 0) ==
                   0 &&
               posix_spawn_file_actions_adddup2(&m_actions, errors, STDERR_FILENO) == 0;
    }
    const posix_spawn_file_actions_t* get() const { return &m_actions; }

private:
    posix_spawn_file_actions_t m_actions;
};

class OwnGroup {
public:
    OwnGroup() {
        posix_spawnattr_init(&m_attributes);
        posix_spawnattr_setpgroup(&m_attributes, 0);
        posix_spawnattr_setflags(&m_attributes, POSIX_SPAWN_SETPGROUP);
    }
    ~OwnGroup() { posix_spawnattr_destroy(&m_attributes); }
    OwnGroup(const OwnGroup&) = delete;
    OwnGroup& operator=(const OwnGroup&) = delete;

    const posix_spawnattr_t* get() const { return &m_attributes; }

private:
    posix_spawnattr_t m_attributes;
};

} // namespace

std::optional<RecorderProcess> RecorderProcess::start(const std::vector<std::string>& arguments) {
    File errors(std::tmpfile());
    FileActions actions;
    if (!errors || !actions.redirect(fileno(errors.get())))
        return std::nullopt;
    std::string name = "quarn";
    std::vector<std::string> words = arguments;
    std::vector<char*> pointers = {name.data()};
    for (std::string& word : words)
        pointers.push_back(word.data());
    pointers.push_back(nullptr);
    const OwnGroup group;
    pid_t id = -1;
    if (posix_spawn(&id, THIS_PROGRAM, actions.get(), group.get(), pointers.data(), environ) != 0)
        return std::nullopt;
    return RecorderProcess(id, std::move(errors));
}

RecorderProcess::RecorderProcess(RecorderProcess&& other) noexcept
    : m_id(std::exchange(other.m_id, -1)), m_has_ended(other.m_has_ended), m_status(other.m_status),
      m_errors(std::move(other.m_errors)) {}

RecorderProcess::~RecorderProcess() {
    if (m_id <= 0 || hasEnded())
        return;
    send(SIGTERM);
    while (waitpid(m_id, &m_status, 0) < 0 && errno == EINTR) {
    }
}

bool RecorderProcess::hasEnded() {
    if (!m_has_ended)
        m_has_ended = waitpid(m_id, &m_status, WNOHANG) == m_id;
    return m_has_ended;
}

std::optional<int> RecorderProcess::exitCode() const {
    if (!m_has_ended || !WIFEXITED(m_status))
        return std::nullopt;
    return WEXITSTATUS(m_status);
}

int RecorderProcess::signal() const {
    return m_has_ended && WIFSIGNALED(m_status) ? WTERMSIG(m_status) : 0;
}

void RecorderProcess::send(int signal) const {
    if (!m_has_ended)
        kill(m_id, signal);
}

std::string RecorderProcess::errors() const {
    std::string text;
    std::rewind(m_errors.get());
    char buffer[4096];
    for (std::size_t read = 0; (read = std::fread(buffer, 1, sizeof buffer, m_errors.get())) > 0;)
        text.append(buffer, read);
    text.resize(text.find_last_not_of('\n') + 1);
    return text;
}

std::string RecorderProcess::endText() const {
    if (const auto code = exitCode())
        return "ended with the exit code " + std::to_string(*code);
    return "was ended by the signal " + std::to_string(signal()) + " (" + strsignal(signal()) + ")";
}

} // namespace quarn::program
