#include "host/recording/FrameSet.h"

#include <algorithm>
#include <cstdint>
#include <numeric>

namespace quarn {

namespace {

/// Whether there is at least one frame between the end of one range and the start of another.
bool isApart(int last, int first) {
    return std::int64_t{last} + 1 < first;
}

} // namespace

FrameSet FrameSet::firstOf(int count) {
    FrameSet frames;
    if (count > 0)
        frames.add(Range{0, count - 1});
    return frames;
}

void FrameSet::add(const Range& range) {
    const auto begin = std::ranges::partition_point(
        m_ranges, [&](const Range& other) { return isApart(other.last, range.first); });
    const auto end = std::partition_point(begin, m_ranges.end(), [&](const Range& other) {
        return !isApart(range.last, other.first);
    });
    Range joined = range;
    if (begin != end) {
        joined.first = std::min(joined.first, begin->first);
        joined.last = std::max(joined.last, std::prev(end)->last);
    }
    m_ranges.insert(m_ranges.erase(begin, end), joined);
}

void FrameSet::add(const FrameSet& frames) {
    for (const Range& range : frames.m_ranges)
        add(range);
}

bool FrameSet::has(int frame) const {
    const auto at = std::ranges::lower_bound(m_ranges, frame, {}, &Range::last);
    return at != m_ranges.end() && at->first <= frame;
}

int FrameSet::count() const {
    return std::accumulate(m_ranges.begin(), m_ranges.end(), 0, [](int sum, const Range& range) {
        return sum + (range.last - range.first + 1);
    });
}

} // namespace quarn
