#pragma once

#include "host/session/RecordingProgress.h"
#include "quarn/farm/FarmTasks.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

enum class StatusForm { text, json };

/// How far what was submitted for a folder is.
struct FarmStatus {
    FarmRecord record;
    RecordingProgressResult recorded;
    std::vector<FarmTask> tasks{};
    std::string slurm_trouble{}; ///< why Slurm tells nothing; empty where it does

    int count(FarmTask::Stage stage) const;
    bool isFinished() const { return recorded.progress.is_finished; }
    /// Whether what the last job makes of the frames is there, too, as far as can be told.
    bool isDone() const;
    /// Whether anything still waits or runs.
    bool goesOn() const;
    /// Frames of tasks that died, that are not there.
    int framesLost() const;
    /// Seconds until all frames are there, as those that run go on; 0 where that is not known.
    double secondsLeft() const;
};

std::string statusText(const FarmStatus& status);
std::string statusJson(const FarmStatus& status);

/// `quarn farm status`. The exit code is 0 where all is done or something goes on.
/// @param folder  that frames are recorded into, or the file NAME.farm.json in it
Outcome tellFarmStatus(const std::filesystem::path& folder, StatusForm form);

/// `quarn farm cancel`: cancels all jobs that were submitted for the folder.
Outcome cancelFarm(const std::filesystem::path& folder);

} // namespace quarn::program
