#include "quarn/farm/FarmStatus.h"

#include "quarn/farm/SlurmCommands.h"
#include "quarn/session/RecordingText.h"

#include <algorithm>

namespace quarn::program {

namespace {

using Path = std::filesystem::path;

RecordingProgressResult recordedIn(const Path& folder, const FarmRecord& record) {
    const Path file = folder / (record.name + ".recording");
    if (!std::filesystem::exists(file))
        return {.progress = {}, .trouble = "no frame was recorded yet."};
    return recordingProgress(file);
}

/// The controller tells of tasks that wait, run and have just ended; the accounting, where there is
/// one, of older ones.
SlurmTelling slurmTelling(const FarmRecord& record) {
    const auto ids = record.ids();
    const auto jobs = slurmJobs(ids);
    if (!jobs)
        return {{}, jobs.message()};
    SlurmTelling telling{accountedJobs(ids), ""};
    telling.jobs.insert(telling.jobs.end(), jobs.value().begin(), jobs.value().end());
    return telling;
}

std::set<int> missingFrames(const FarmRecord& record, const RecordingProgressResult& recorded) {
    if (recorded.trouble.empty())
        return {recorded.progress.missing.begin(), recorded.progress.missing.end()};
    std::set<int> all;
    for (int frame = 0; frame < record.frames; ++frame)
        all.insert(frame);
    return all;
}

Result<FarmStatus> readStatus(const Path& folder) {
    const auto record = readFarmRecord(folder);
    if (!record)
        return record.error();
    FarmStatus status{.record = record.value(),
                      .recorded = recordedIn(farmFolder(folder), record.value())};
    const SlurmTelling slurm = slurmTelling(status.record);
    status.slurm_trouble = slurm.trouble;
    const FarmFiles files(farmFolder(folder), status.record.name);
    status.tasks =
        farmTasks(status.record, files.logs, slurm, missingFrames(status.record, status.recorded));
    return status;
}

} // namespace

int FarmStatus::count(FarmTask::Stage stage) const {
    return static_cast<int>(std::ranges::count(tasks, stage, &FarmTask::stage));
}

bool FarmStatus::goesOn() const {
    if (slurm_trouble.empty())
        return count(FarmTask::Stage::waiting) + count(FarmTask::Stage::running) > 0;
    return std::ranges::any_of(recorded.progress.writers, &RecordingWriter::is_alive);
}

bool FarmStatus::isDone() const {
    return isFinished() && (tasks.empty() || tasks.back().stage != FarmTask::Stage::died);
}

int FarmStatus::framesLost() const {
    const std::set<int> missing = missingFrames(record, recorded);
    int lost = 0;
    for (const FarmTask& task : tasks)
        if (task.stage == FarmTask::Stage::died)
            lost += static_cast<int>(std::ranges::count_if(
                framesOf(task.frames), [&](int frame) { return missing.contains(frame); }));
    return lost;
}

double FarmStatus::secondsLeft() const {
    int frames = 0;
    double seconds = 0.0;
    for (const RecordingWriter& writer : recorded.progress.writers) {
        frames += writer.frames;
        seconds += writer.seconds;
    }
    const int running = count(FarmTask::Stage::running);
    if (frames == 0 || running == 0)
        return 0.0;
    return seconds / frames * static_cast<double>(recorded.progress.missing.size()) / running;
}

Outcome tellFarmStatus(const Path& folder, StatusForm form) {
    const auto status = readStatus(folder);
    if (!status)
        return Outcome::failure(status.message());
    const std::string text =
        form == StatusForm::json ? statusJson(status.value()) : statusText(status.value());
    const bool is_well = status.value().goesOn() || status.value().isDone();
    return {is_well ? Outcome::done : Outcome::failed, text};
}

Outcome cancelFarm(const Path& folder) {
    const auto record = readFarmRecord(folder);
    if (!record)
        return Outcome::failure(record.message());
    if (const auto missing = whySlurmIsMissing())
        return Outcome::failure(*missing);
    std::string refusals;
    for (const std::string& id : record.value().ids())
        if (const auto cancelled = cancelJob(id); !cancelled)
            refusals += (refusals.empty() ? "" : "; ") + cancelled.message();
    if (!refusals.empty())
        return Outcome::failure(refusals);
    const auto recorded = recordedIn(farmFolder(folder), record.value());
    const int there =
        recorded.trouble.empty()
            ? recorded.progress.frames - static_cast<int>(recorded.progress.missing.size())
            : 0;
    return Outcome::success("Cancelled. " + std::to_string(there) + " of " +
                            frameCountText(record.value().frames) + (there == 1 ? " is" : " are") +
                            " there and stay; quarn farm submit goes on with the others.");
}

} // namespace quarn::program
