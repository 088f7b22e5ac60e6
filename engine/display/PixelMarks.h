#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

/// Which pixels of a picture differ visibly from one of their four neighbours, in colour or object
/// (every visible step of normal or depth brings one of both with it). Pixels are compared as the
/// rays left them: a block is looked at before any pixel of it or next to it is smoothed.
class PixelMarks {
public:
    /// Blocks begin at multiples of this, and are as wide but at the picture's right side.
    static constexpr int block_width = 64;

    /// Makes room for a picture; keeps its memory for the next one.
    void resize(int width, int height);

    /// Marks those among the pixels of a block, which has just been traced. Different
    /// blocks may be looked at by different threads at the same time.
    void markInside(const FrameSetup& frame, const RayKernel& kernel, const PixelBlock& block);

    /// Marks more pixels of the block: those that differ from a neighbour in another block, which
    /// must be as it was traced. Different blocks may be looked at at the same time.
    void markAcross(const FrameSetup& frame, const RayKernel& kernel, const PixelBlock& block);

    /// Calls visit(x, y) for each marked pixel of a part of a block, such that those which follow
    /// each other lie near each other.
    template <class Visit> void forEach(const PixelBlock& part, const Visit& visit) const {
        for (int top = part.y_begin; top < part.y_end; top += cell_size)
            for (int left = part.x_begin; left < part.x_end; left += cell_size)
                for (int y = top; y < top + cell_size && y < part.y_end; ++y)
                    for (std::uint64_t found = someFrom(left, part.x_end, y); found != 0;
                         found &= found - 1)
                        visit(left + __builtin_ctzll(found), y);
    }

private:
    static constexpr int cell_size = 8;

    std::uint64_t& rowOfBlock(int x, int y) { return m_rows[place(x, y)]; }
    std::size_t place(int x, int y) const {
        return static_cast<std::size_t>(y) * m_columns + static_cast<std::size_t>(x / block_width);
    }
    /// The marks of up to a cell's pixels in a row, the first in the lowest bit.
    std::uint64_t someFrom(int x, int x_end, int y) const {
        const int count = x_end - x < cell_size ? x_end - x : cell_size;
        return m_rows[place(x, y)] >> (x % block_width) & ((std::uint64_t{1} << count) - 1);
    }

    std::size_t m_columns = 0;         ///< of blocks
    std::vector<std::uint64_t> m_rows; ///< a bit for each pixel of a block's row
};

} // namespace quarn
