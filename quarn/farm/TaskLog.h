#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// One start of a task, as the task's own log tells of it.
struct TaskAttempt {
    std::string node;
    std::optional<int> exit_code{}; ///< nothing: it runs, or it ended without a word
    std::string words{};            ///< why it ended: what quarn or Slurm wrote last, or nothing
};

/// Reads what the job script, quarn and Slurm wrote into the log of a task.
std::vector<TaskAttempt> readTaskLog(const std::string& text);

/// The attempts of a task, by its log's file; none where there is no such file.
std::vector<TaskAttempt> taskAttempts(const std::filesystem::path& log);

} // namespace quarn::program
