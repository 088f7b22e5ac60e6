#pragma once

#include <cstdio>
#include <memory>
#include <optional>
#include <string>
#include <sys/types.h>
#include <vector>

namespace quarn::program {

/// This program once more, in a process and a process group of its own: what a terminal sends to
/// this program does not reach it twice. What it says goes nowhere, but for its error messages,
/// which are kept.
class RecorderProcess {
public:
    /// @param arguments  behind the program's name; no shell reads them
    /// @return nothing when the system starts no more
    static std::optional<RecorderProcess> start(const std::vector<std::string>& arguments);

    RecorderProcess(RecorderProcess&& other) noexcept;
    RecorderProcess& operator=(RecorderProcess&&) = delete;
    RecorderProcess(const RecorderProcess&) = delete;
    RecorderProcess& operator=(const RecorderProcess&) = delete;
    /// One that still runs is asked to end, and waited for.
    ~RecorderProcess();

    pid_t id() const { return m_id; }
    /// Whether it runs no more; waits for nothing.
    bool hasEnded();
    /// Its exit code; nothing while it runs and where a signal ended it.
    std::optional<int> exitCode() const;
    /// The signal that ended it; 0 while it runs and where it ended otherwise.
    int signal() const;
    /// Hands a signal on; one that has ended gets none.
    void send(int signal) const;
    /// What it wrote to its error output, without the line break at the end; UTF-8.
    std::string errors() const;
    /// How it ended: "ended with the exit code 1", "was ended by the signal 9 (Killed)".
    std::string endText() const;

private:
    struct Closer {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };
    using File = std::unique_ptr<std::FILE, Closer>;

    RecorderProcess(pid_t id, File errors) : m_id(id), m_errors(std::move(errors)) {}

    pid_t m_id = -1;
    bool m_has_ended = false;
    int m_status = 0;
    File m_errors;
};

} // namespace quarn::program
