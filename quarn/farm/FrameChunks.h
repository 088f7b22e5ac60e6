#pragma once

#include "ground/Result.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// How a person wants frames to be shared out; 0: not said.
struct ChunkWish {
    int tasks = 0;        ///< so many chunks
    int chunk_frames = 0; ///< so many frames in each
    double limit_s = 0.0; ///< that a task may take, as Slurm counts it
};

/// What one frame costs on one task.
struct FrameCost {
    double frame_s = 0.0;   ///< 0: not known
    double loading_s = 0.0; ///< until the first frame begins; 0: not known
};

/// Frames for each task, each in rising order, from 0.
using FrameChunks = std::vector<std::vector<int>>;

/// How long before its end a task is asked to stop: one frame, rounded up.
int warningSeconds(const FrameCost& cost);

/// The frames that a task makes where nobody says it: for five minutes, or for so long that loading
/// is a twentieth; and no longer than the time limit allows.
int usualChunkFrames(const FrameCost& cost, double limit_s);

/// Shares out frames in chunks of nearly the same size.
/// @param frames      in rising order; not empty
/// @param most_tasks  that the cluster takes
/// @return an error where the time limit is too short for the frames, or where the chunks are more
///         than the cluster takes and the person chose their number
Result<FrameChunks> shareOut(const std::vector<int>& frames, const ChunkWish& wish,
                             const FrameCost& cost, int most_tasks);

/// "0-9,12-12": the frames as --frames takes them.
std::string rangesText(const std::vector<int>& frames);
/// The frames of such a text; empty for another one.
std::vector<int> framesOf(const std::string& ranges);

} // namespace quarn::program
