#pragma once

#include "quarn/farm/FrameChunks.h"
#include "quarn/scripts/FilmScript.h"
#include "quarn/scripts/ViewerScript.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn::program {

/// A recording that a cluster is to make.
struct FarmRequest {
    std::filesystem::path document;
    std::filesystem::path folder;
    ChunkWish chunks;
    std::optional<double> frame_s; ///< nothing: one frame is drawn to measure it
    std::string partition;         ///< empty: the cluster's own
    std::string time;              ///< as sbatch takes it; empty: the partition's
    int cpus = 1;                  ///< of a task
    int retries = 0;               ///< of frames that are still missing in the end
    std::filesystem::path stage; ///< on the nodes' own disks; empty: documents stay where they are
    std::string instructions;    ///< empty: the first task chooses
    bool overwrites = false;
    FilmRequest film;
    ViewerRequest viewer;
    bool is_only_shown = false;
};

} // namespace quarn::program
