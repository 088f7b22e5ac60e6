#include "import/ReadingProgress.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::chrono::milliseconds BETWEEN_TELLINGS{50};

} // namespace

ReadingProgress::ReadingProgress(ReadingWatch& watch, ReadingStep step, std::uint64_t all)
    : m_watch(watch), m_step(step), m_all(std::max<std::uint64_t>(all, 1)) {}

bool ReadingProgress::goesOn(std::uint64_t done) {
    m_done += done;
    const std::unique_lock lock(m_telling, std::try_to_lock);
    const Clock::time_point now = Clock::now();
    if (!lock || !m_goes_on || now - m_told < BETWEEN_TELLINGS)
        return m_goes_on;
    m_told = now;
    const double share = static_cast<double>(m_done) / static_cast<double>(m_all);
    if (!m_watch.goesOn(m_step, std::min(share, 1.0)))
        m_goes_on = false;
    return m_goes_on;
}

} // namespace quarn
