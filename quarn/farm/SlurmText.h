#pragma once

#include "ground/Result.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// A job, or a task of an array, as the controller tells of it.
struct SlurmJob {
    std::string id;           ///< of the array, or of a job that is none
    std::vector<int> tasks{}; ///< of the array: one, or all that wait together; empty: it is none
    std::string state{};      ///< "RUNNING", "NODE_FAIL", ...
    std::string reason{};     ///< "None", "NonZeroExitCode", "Resources", ...
    std::string node{};       ///< empty: none yet
    std::string exit_code{};  ///< "1:0": the code, and the signal
    int restarts = 0;

    /// Whether it waits, runs, or is about to wait again.
    bool isLive() const;
    bool isWaiting() const { return state == "PENDING" || state.starts_with("REQUEUE"); }
    /// Whether it ended before its work was done, and not by a person's wish.
    bool hasDied() const;
};

/// What `scontrol show job -o` prints: a job a line.
std::vector<SlurmJob> readJobs(const std::string& text);
/// What `sacct --parsable2 --format=JobID,State,ExitCode,NodeList` prints.
std::vector<SlurmJob> readAccounts(const std::string& text);

/// How much the cluster takes.
struct SlurmLimits {
    int array_size = 1001; ///< task numbers are below it; as Slurm has it where nobody says it
    int jobs = 10000;      ///< that it holds at a time, each task counted
};

/// What `scontrol show config` prints.
SlurmLimits readLimits(const std::string& text);

/// What a program of Slurm says when it refuses, as one sentence without its own name.
std::string refusalText(const std::string& error_output);

/// A time as --time takes it: "90" minutes, "90:00", "1:30:00", "1-6", "1-6:00" or "1-6:00:00".
/// @return in seconds, in whole minutes as Slurm counts them; nothing for another text
std::optional<double> limitSeconds(const std::string& time);

} // namespace quarn::program
