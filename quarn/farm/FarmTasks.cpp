#include "quarn/farm/FarmTasks.h"

#include "quarn/farm/TaskLog.h"

#include <algorithm>
#include <map>

namespace quarn::program {

namespace {

using Stage = FarmTask::Stage;

constexpr int STOPPED = 143; // by SIGTERM: it goes on where it is started again

/// Jobs by what logs and people call them: "12_7", "13".
std::map<std::string, const SlurmJob*> byName(const std::vector<SlurmJob>& jobs) {
    std::map<std::string, const SlurmJob*> named;
    for (const SlurmJob& job : jobs) {
        if (job.tasks.empty())
            named[job.id] = &job;
        for (const int task : job.tasks)
            named[job.id + "_" + std::to_string(task)] = &job;
    }
    return named;
}

std::string endText(const TaskAttempt& attempt) {
    if (!attempt.exit_code)
        return attempt.words.empty() ? "it was killed, or its node was lost" : attempt.words;
    const std::string code = "exit code " + std::to_string(*attempt.exit_code);
    return attempt.words.empty() ? code : code + ", " + attempt.words;
}

/// "NODE_FAIL", "FAILED, NonZeroExitCode, quarn: ..."
std::string reasonOf(const SlurmJob& job, const std::vector<TaskAttempt>& attempts) {
    if (job.state == "CANCELLED")
        return job.state; // what it waited for before explains nothing
    std::string text = job.state;
    if (!job.reason.empty() && job.reason != "None")
        text += ", " + job.reason;
    if (!attempts.empty())
        text += ", " + endText(attempts.back());
    return text;
}

/// An attempt that ended between two frames, because it was asked to, is no trouble.
std::vector<std::string> formerEnds(const std::vector<TaskAttempt>& attempts) {
    std::vector<std::string> ends;
    for (std::size_t i = 0; i + 1 < attempts.size(); ++i)
        if (!attempts[i].exit_code.has_value() ||
            (attempts[i].exit_code != STOPPED && attempts[i].exit_code != 0))
            ends.push_back("on " + attempts[i].node + ": " + endText(attempts[i]));
    return ends;
}

/// A task that waits again has left its last attempt behind, too.
std::vector<TaskAttempt> withOneToCome(std::vector<TaskAttempt> attempts) {
    attempts.push_back({});
    return attempts;
}

void tellAsSlurm(const SlurmJob& job, const std::vector<TaskAttempt>& attempts, FarmTask& task) {
    task.node = job.node;
    if (job.isLive()) {
        task.stage = job.isWaiting() ? Stage::waiting : Stage::running;
        task.reason = job.isWaiting() ? job.reason : "";
        task.former = formerEnds(job.isWaiting() ? withOneToCome(attempts) : attempts);
        return;
    }
    task.former = formerEnds(attempts);
    task.stage = job.state == "COMPLETED" ? Stage::done : Stage::died;
    if (task.stage == Stage::died)
        task.reason = reasonOf(job, attempts);
}

/// Slurm knows the task no more, or does not answer.
void tellAsLog(const std::vector<TaskAttempt>& attempts, bool is_asked, FarmTask& task) {
    if (attempts.empty()) {
        task.stage = is_asked ? Stage::died : Stage::waiting;
        task.reason = is_asked ? "it never began, and Slurm knows it no more" : "";
        return;
    }
    const TaskAttempt& last = attempts.back();
    task.node = last.node;
    task.former = formerEnds(attempts);
    if (!last.exit_code && !is_asked) {
        task.stage = Stage::running;
        return;
    }
    task.stage = last.exit_code == 0 ? Stage::done : Stage::died;
    if (task.stage == Stage::died)
        task.reason = endText(last);
}

class TaskReader {
public:
    TaskReader(const std::filesystem::path& logs, const SlurmTelling& slurm,
               const std::set<int>& missing)
        : m_logs(logs), m_slurm(slurm), m_missing(missing), m_named(byName(slurm.jobs)) {}

    FarmTask read(const std::string& id, const std::string& frames) const {
        FarmTask task{.id = id, .frames = frames};
        const auto found = m_named.find(id);
        const SlurmJob* const job = found == m_named.end() ? nullptr : found->second;
        if (!job && isWhole(frames)) {
            task.stage = Stage::done;
            return task;
        }
        const auto attempts =
            needsLog(job) ? taskAttempts(m_logs / (id + ".log")) : std::vector<TaskAttempt>{};
        if (job)
            tellAsSlurm(*job, attempts, task);
        else
            tellAsLog(attempts, m_slurm.trouble.empty(), task);
        return task;
    }

private:
    /// Logs are many, and often far away.
    static bool needsLog(const SlurmJob* job) {
        return !job || job->restarts > 0 || job->hasDied();
    }
    bool isWhole(const std::string& frames) const {
        return !frames.empty() && std::ranges::none_of(framesOf(frames), [this](int frame) {
            return m_missing.contains(frame);
        });
    }

    const std::filesystem::path& m_logs;
    const SlurmTelling& m_slurm;
    const std::set<int>& m_missing;
    std::map<std::string, const SlurmJob*> m_named;
};

} // namespace

std::vector<FarmTask> farmTasks(const FarmRecord& record, const std::filesystem::path& logs,
                                const SlurmTelling& slurm, const std::set<int>& missing) {
    const TaskReader reader(logs, slurm, missing);
    std::vector<FarmTask> tasks;
    for (const SubmittedArray& array : record.arrays)
        for (int task = 0; task < array.tasks; ++task) {
            const auto chunk = static_cast<std::size_t>(array.first + task);
            const std::string frames =
                chunk < record.chunks.size() ? record.chunks[chunk] : std::string();
            tasks.push_back(reader.read(array.id + "_" + std::to_string(task), frames));
        }
    if (!record.finish_id.empty())
        tasks.push_back(reader.read(record.finish_id, ""));
    return tasks;
}

} // namespace quarn::program
