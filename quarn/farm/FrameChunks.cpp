#include "quarn/farm/FrameChunks.h"

#include "quarn/terminal/FramePace.h"
#include "quarn/words/Words.h"

#include <algorithm>
#include <cmath>
#include <sstream>

namespace quarn::program {

namespace {

constexpr double USUAL_CHUNK_S = 300.0;
constexpr double LOADINGS_IN_A_CHUNK = 19.0; // beside them loading is a twentieth
constexpr int LEAST_WARNING_S = 5;
constexpr int WARNING_OF_UNKNOWN_FRAMES_S = 60;
constexpr int MOST_WARNING_S = 65535; // that Slurm takes

/// What is left of a time limit for frames.
double drawingSeconds(const FrameCost& cost, double limit_s) {
    return limit_s - cost.loading_s - warningSeconds(cost);
}

/// Parts that differ by one frame at the most.
FrameChunks inParts(const std::vector<int>& frames, std::size_t parts) {
    FrameChunks chunks;
    for (std::size_t part = 0; part < parts; ++part) {
        const auto from = frames.begin() + static_cast<long>(frames.size() * part / parts);
        const auto to = frames.begin() + static_cast<long>(frames.size() * (part + 1) / parts);
        chunks.emplace_back(from, to);
    }
    return chunks;
}

FrameChunks inChunksOf(const std::vector<int>& frames, std::size_t size) {
    FrameChunks chunks;
    for (std::size_t from = 0; from < frames.size(); from += size)
        chunks.emplace_back(frames.begin() + static_cast<long>(from),
                            frames.begin() +
                                static_cast<long>(std::min(from + size, frames.size())));
    return chunks;
}

FrameChunks wished(const std::vector<int>& frames, const ChunkWish& wish, const FrameCost& cost,
                   std::size_t most_tasks) {
    if (wish.chunk_frames > 0)
        return inChunksOf(frames, static_cast<std::size_t>(wish.chunk_frames));
    const std::size_t size = static_cast<std::size_t>(usualChunkFrames(cost, wish.limit_s));
    const std::size_t usual = std::min((frames.size() + size - 1) / size, most_tasks);
    const std::size_t tasks = wish.tasks > 0 ? static_cast<std::size_t>(wish.tasks) : usual;
    return inParts(frames, std::min(tasks, frames.size()));
}

} // namespace

int warningSeconds(const FrameCost& cost) {
    if (cost.frame_s <= 0.0)
        return WARNING_OF_UNKNOWN_FRAMES_S;
    return static_cast<int>(
        std::clamp(std::ceil(cost.frame_s), 1.0 * LEAST_WARNING_S, 1.0 * MOST_WARNING_S));
}

int usualChunkFrames(const FrameCost& cost, double limit_s) {
    if (cost.frame_s <= 0.0)
        return 1;
    double seconds = std::max(USUAL_CHUNK_S, LOADINGS_IN_A_CHUNK * cost.loading_s);
    if (limit_s > 0.0)
        seconds = std::min(seconds, drawingSeconds(cost, limit_s));
    return static_cast<int>(std::clamp(std::floor(seconds / cost.frame_s), 1.0, 1e9));
}

Result<FrameChunks> shareOut(const std::vector<int>& frames, const ChunkWish& wish,
                             const FrameCost& cost, int most_tasks) {
    const double least_s = cost.loading_s + 2.0 * cost.frame_s;
    if (wish.limit_s > 0.0 && wish.limit_s < least_s)
        return Error{"--time gives a task " + timeText(wish.limit_s) +
                     ", but loading and two frames take " + timeText(least_s) + "; give it more."};
    FrameChunks chunks = wished(frames, wish, cost, static_cast<std::size_t>(most_tasks));
    if (chunks.size() > static_cast<std::size_t>(most_tasks))
        return Error{"these are " + std::to_string(chunks.size()) +
                     " tasks, and the cluster takes " + std::to_string(most_tasks) +
                     " more jobs; give fewer --tasks, or a larger --chunk."};
    return chunks;
}

std::string rangesText(const std::vector<int>& frames) {
    std::string text;
    for (std::size_t first = 0; first < frames.size();) {
        std::size_t last = first;
        while (last + 1 < frames.size() && frames[last + 1] == frames[last] + 1)
            ++last;
        text += (text.empty() ? "" : ",") + std::to_string(frames[first]) + "-" +
                std::to_string(frames[last]);
        first = last + 1;
    }
    return text;
}

std::vector<int> framesOf(const std::string& ranges) {
    std::vector<int> frames;
    std::istringstream stream(ranges);
    for (std::string range; std::getline(stream, range, ',');) {
        const std::size_t hyphen = range.find('-');
        const auto first = wholeNumber(range.substr(0, hyphen));
        const auto last =
            hyphen == std::string::npos ? std::nullopt : wholeNumber(range.substr(hyphen + 1));
        if (!first || !last || *first < 0 || *last < *first || *last - *first > 100'000'000)
            return {};
        for (int frame = *first; frame <= *last; ++frame)
            frames.push_back(frame);
    }
    return frames;
}

} // namespace quarn::program
