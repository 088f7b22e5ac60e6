#pragma once

#include "engine/render/AlignedNumbers.h"

#include <cstddef>

namespace quarn {

/// A number for each pixel of a picture, row by row. Beside every row there is room, all 0, that a
/// filter may look into as if the picture went on.
class PixelPlane {
public:
    /// How far beside the picture a filter may look.
    static constexpr int margin = 32;

    PixelPlane() = default;
    PixelPlane(int width, int height)
        : m_stride(strideOf(width)),
          m_numbers(static_cast<std::size_t>(m_stride) * static_cast<std::size_t>(height)) {}

    /// The first pixel of a row.
    float* row(int y) { return m_numbers.data() + m_stride * y + margin; }
    const float* row(int y) const { return m_numbers.data() + m_stride * y + margin; }

    /// From a pixel to the one below.
    std::ptrdiff_t stride() const { return m_stride; }

private:
    static std::ptrdiff_t strideOf(int width) {
        return (width + lane_count - 1) / lane_count * lane_count + 2 * margin;
    }

    std::ptrdiff_t m_stride = 0;
    AlignedNumbers m_numbers;
};

} // namespace quarn
