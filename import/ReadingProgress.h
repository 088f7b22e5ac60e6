#pragma once

#include "import/ReadingWatch.h"

#include <atomic>
#include <chrono>
#include <cstdint>
#include <mutex>

namespace quarn {

/// Tells who watches a reading how far a step is, a few times a second, while several threads work
/// on it.
class ReadingProgress {
public:
    /// @param all  of the work in the step, in any measure
    ReadingProgress(ReadingWatch& watch, ReadingStep step, std::uint64_t all);

    /// Counts work that is done. May be called by several threads at once.
    /// @return false once the reading was given up
    bool goesOn(std::uint64_t done);

private:
    using Clock = std::chrono::steady_clock;

    ReadingWatch& m_watch;
    ReadingStep m_step;
    std::uint64_t m_all;
    std::atomic<std::uint64_t> m_done = 0;
    std::atomic<bool> m_goes_on = true;
    std::mutex m_telling; ///< who holds it may tell
    Clock::time_point m_told;
};

} // namespace quarn
