#pragma once

#include "host/session/RecordingProgress.h"
#include "quarn/session/ConsoleFrontEnd.h"
#include "quarn/words/FrameRanges.h"

#include <chrono>
#include <filesystem>
#include <string>
#include <vector>

namespace quarn::program {

/// Other programs that record frames of the same recording, while they are waited for.
class OtherRecorders {
public:
    using Clock = std::chrono::steady_clock;

    /// @param recording  its NAME.recording
    /// @param part       the frames that are waited for
    OtherRecorders(std::filesystem::path recording, FrameRanges part, ConsoleFrontEnd& front_end)
        : m_recording(std::move(recording)), m_part(std::move(part)), m_front_end(front_end) {}

    /// Waits until it is worth it to look whether frames are left to record.
    /// @param look  how long the last look took
    /// @return false where the person stopped it, and where nothing has come for so long that the
    ///         others are given up
    bool wait(Clock::duration look);
    /// Why they were given up, in a sentence; empty where they were not.
    const std::string& reason() const { return m_reason; }

private:
    void noteMissing(const RecordingProgress& progress);
    bool areGivenUp(const RecordingProgress& progress);

    std::filesystem::path m_recording;
    FrameRanges m_part;
    ConsoleFrontEnd& m_front_end;
    std::vector<int> m_missing;
    Clock::time_point m_last_change{};
    std::string m_reason;
};

/// Who records now: "node1 and node2"; empty where nobody does.
std::string livingHostsText(const RecordingProgress& progress);

/// How long after the last frame the recorders are given up: longer than a lease lasts, so that
/// frames of one that is lost have become free, and longer than slow frames take.
OtherRecorders::Clock::duration patienceWith(const RecordingProgress& progress);

} // namespace quarn::program
