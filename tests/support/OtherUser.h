#pragma once

#include <functional>
#include <grp.h>
#include <sys/wait.h>
#include <unistd.h>

namespace quarn::test {

/// The user and the group that own nothing.
constexpr unsigned NOBODY = 65534;

inline bool isRoot() {
    return geteuid() == 0;
}

/// Runs something as an ordinary user, in a process of its own where the tests run as root: root
/// may do everything, so nothing would be refused to it.
/// @param work  returns whether it went as it should
inline bool runAsOrdinaryUser(const std::function<bool()>& work) {
    if (!isRoot())
        return work();
    const pid_t child = fork();
    if (child == 0) {
        const bool is_other =
            setgroups(0, nullptr) == 0 && setgid(NOBODY) == 0 && setuid(NOBODY) == 0;
        _exit(is_other && work() ? 0 : 1);
    }
    int status = 0;
    return child > 0 && waitpid(child, &status, 0) == child && WIFEXITED(status) &&
           WEXITSTATUS(status) == 0;
}

} // namespace quarn::test
