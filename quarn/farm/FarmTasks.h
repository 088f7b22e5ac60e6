#pragma once

#include "quarn/farm/FarmRecord.h"
#include "quarn/farm/SlurmText.h"

#include <set>
#include <string>
#include <vector>

namespace quarn::program {

/// What became of a task of an array, or of the last job.
struct FarmTask {
    enum class Stage { waiting, running, done, died };

    std::string id;     ///< "12_7", or "13" for the last job
    std::string frames; ///< as --frames takes them; empty: of the last job
    Stage stage = Stage::waiting;
    std::string node{};                ///< it runs or ended on; empty: none, or not known
    std::string reason{};              ///< why it waits or died; may be empty
    std::vector<std::string> former{}; ///< how its earlier starts ended, a sentence each
};

/// What Slurm tells, as far as it does.
struct SlurmTelling {
    std::vector<SlurmJob> jobs;
    std::string trouble; ///< why it tells nothing; empty where it does
};

/// Puts together what Slurm, the logs and the frames tell: Slurm forgets ended jobs after minutes,
/// and a task whose node is lost writes nothing.
/// @param missing  frames that are not there
std::vector<FarmTask> farmTasks(const FarmRecord& record, const std::filesystem::path& logs,
                                const SlurmTelling& slurm, const std::set<int>& missing);

} // namespace quarn::program
