#include "host/commands/DesktopOpener.h"

#include "host/front_end/FrontEnd.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstring>
#include <memory>
#include <optional>

extern char** environ;

namespace quarn {

namespace {

constexpr const char* OPENER = "xdg-open";
constexpr unsigned WATCHED_MS = 1000;
constexpr unsigned STEP_MS = 10;

/// What a new program starts with: a session of its own, so that Ctrl-C here does not end it, and
/// no input or output.
class DetachedStart {
public:
    DetachedStart() {
        posix_spawnattr_init(&m_attributes);
        posix_spawnattr_setflags(&m_attributes, POSIX_SPAWN_SETSID);
        posix_spawn_file_actions_init(&m_actions);
        posix_spawn_file_actions_addopen(&m_actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&m_actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_addopen(&m_actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    }
    ~DetachedStart() {
        posix_spawn_file_actions_destroy(&m_actions);
        posix_spawnattr_destroy(&m_attributes);
    }
    DetachedStart(const DetachedStart&) = delete;
    DetachedStart& operator=(const DetachedStart&) = delete;

    Result<pid_t> start(const char* program, std::string argument) const {
        std::string name = program;
        char* arguments[] = {name.data(), argument.data(), nullptr};
        pid_t child = 0;
        const int error =
            posix_spawnp(&child, program, &m_actions, &m_attributes, arguments, environ);
        if (error != 0)
            return Error{std::strerror(error)};
        return child;
    }

private:
    posix_spawnattr_t m_attributes;
    posix_spawn_file_actions_t m_actions;
};

/// Waits for the program, but not long. @return its exit status, nothing while it still runs
std::optional<int> watch(pid_t child, FrontEnd& front_end) {
    int status = 0;
    for (unsigned waited_ms = 0; waited_ms < WATCHED_MS; waited_ms += STEP_MS) {
        if (waitpid(child, &status, WNOHANG) == child)
            return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        front_end.pumpEvents(STEP_MS);
    }
    return std::nullopt;
}

} // namespace

Result<void> openWithDesktop(const std::filesystem::path& file, FrontEnd& front_end) {
    std::error_code error;
    const std::filesystem::path whole_path = std::filesystem::absolute(file, error);
    if (error || !std::filesystem::exists(whole_path, error))
        return Error{"There is no file " + file.string() + " to open."};
    const DetachedStart detached;
    const Result<pid_t> child = detached.start(OPENER, whole_path.string());
    if (!child)
        return Error{"The file " + whole_path.string() + " cannot be opened: " + OPENER +
                     " cannot be started: " + child.message() + "."};
    const std::optional<int> status = watch(child.value(), front_end);
    if (status.value_or(0) == 0)
        return {};
    return Error{"The file " + whole_path.string() + " cannot be opened: " + OPENER +
                 " ended with code " + std::to_string(*status) + "."};
}

} // namespace quarn
