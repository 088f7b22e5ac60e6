#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// Numbers that begin where loops over sixteen at a time can load them; all 0 at first.
class AlignedNumbers {
public:
    AlignedNumbers() = default;
    /// @param count  rounded up to whole sixteens
    explicit AlignedNumbers(std::size_t count) : m_lines((count + lane_count - 1) / lane_count) {}

    float* data() { return m_lines.empty() ? nullptr : m_lines.front().values; }
    const float* data() const { return m_lines.empty() ? nullptr : m_lines.front().values; }

private:
    struct alignas(64) Line {
        float values[lane_count];
    };
    std::vector<Line> m_lines;
};

} // namespace quarn
