#include "engine/display/PixelMarks.h"

namespace quarn {

namespace {

std::size_t offset(const FrameSetup& frame, int x, int y) {
    return static_cast<std::size_t>(y) * static_cast<std::size_t>(frame.width) +
           static_cast<std::size_t>(x);
}

} // namespace

void PixelMarks::resize(int width, int height) {
    m_columns = static_cast<std::size_t>((width + block_width - 1) / block_width);
    m_rows.resize(m_columns * static_cast<std::size_t>(height));
}

void PixelMarks::markInside(const FrameSetup& frame, const RayKernel& kernel,
                            const PixelBlock& block) {
    const int width = block.x_end - block.x_begin;
    std::uint64_t from_above = 0;
    for (int y = block.y_begin; y < block.y_end; ++y) {
        const std::size_t row = offset(frame, block.x_begin, y);
        const std::uint64_t to_right = kernel.find_steps(frame, row, row + 1, width - 1);
        std::uint64_t below = 0;
        if (y + 1 < block.y_end)
            below = kernel.find_steps(frame, row, offset(frame, block.x_begin, y + 1), width);
        rowOfBlock(block.x_begin, y) = from_above | below | to_right | to_right << 1;
        from_above = below;
    }
}

void PixelMarks::markAcross(const FrameSetup& frame, const RayKernel& kernel,
                            const PixelBlock& block) {
    const int width = block.x_end - block.x_begin;
    const auto compare_rows = [&](int y, int other) {
        rowOfBlock(block.x_begin, y) |= kernel.find_steps(
            frame, offset(frame, block.x_begin, y), offset(frame, block.x_begin, other), width);
    };
    if (block.y_begin > 0)
        compare_rows(block.y_begin, block.y_begin - 1);
    if (block.y_end < frame.height)
        compare_rows(block.y_end - 1, block.y_end);
    const auto compare_sideways = [&](int x, int other, int y) {
        rowOfBlock(x, y) |=
            kernel.find_steps(frame, offset(frame, x, y), offset(frame, other, y), 1)
            << (x % block_width);
    };
    for (int y = block.y_begin; y < block.y_end; ++y) {
        if (block.x_begin > 0)
            compare_sideways(block.x_begin, block.x_begin - 1, y);
        if (block.x_end < frame.width)
            compare_sideways(block.x_end - 1, block.x_end, y);
    }
}

} // namespace quarn
