#pragma once

#include "quarn/farm/SlurmText.h"

namespace quarn::program {

/// What a job is submitted with.
struct JobOptions {
    std::string name;      ///< of the animation
    std::string folder;    ///< it runs in, absolute
    std::string partition; ///< empty: the cluster's own
    std::string time;      ///< as --time of sbatch; empty: the partition's
    int cpus = 1;          ///< processors of a task
    int warning_s = 0;     ///< how long before the end of its time it is asked to stop
};

/// Says why jobs cannot be submitted from this machine.
/// @return nothing where Slurm's commands are here
std::optional<std::string> whySlurmIsMissing();

/// What the cluster takes, of which jobs that are in it already have taken some.
Result<SlurmLimits> slurmLimits();

/// The words of the command that submits an array; tasks are counted from 0.
/// @param rest  the script and its words
std::vector<std::string> arrayWords(const JobOptions& options, int tasks,
                                    const std::string& log_pattern,
                                    const std::vector<std::string>& rest);
/// The same for one job that begins when others have ended, however they did.
std::vector<std::string> followingWords(const JobOptions& options,
                                        const std::vector<std::string>& ids,
                                        const std::string& log_pattern,
                                        const std::vector<std::string>& rest);

/// A file of a folder as the pattern of a log's name, in which Slurm replaces what is behind "%".
/// In a folder whose path holds a backslash it can have no such logs: there they go nowhere.
/// @param file  a pattern
std::string logPattern(const std::string& folder, const std::string& file);

/// @return the job's id, or the refusal
Result<std::string> submitJob(const std::vector<std::string>& words);

/// The jobs with these ids that the controller still knows: it forgets ended ones after minutes.
Result<std::vector<SlurmJob>> slurmJobs(const std::vector<std::string>& ids);
/// What the accounting knows of them; empty where there is none.
std::vector<SlurmJob> accountedJobs(const std::vector<std::string>& ids);

/// Cancels a job; one that has ended is no error.
Result<void> cancelJob(const std::string& id);

} // namespace quarn::program
