#include "engine/display/MarkedPixels.h"

#include "engine/display/PixelSmoother.h"

#include <array>
#include <numeric>

namespace quarn {

namespace {

/// A block but for the pixels that have a neighbour in another block.
PixelBlock insideOf(const PixelBlock& block, const FrameSetup& frame) {
    return {block.x_begin + (block.x_begin > 0 ? 1 : 0),
            block.y_begin + (block.y_begin > 0 ? 1 : 0),
            block.x_end - (block.x_end < frame.width ? 1 : 0),
            block.y_end - (block.y_end < frame.height ? 1 : 0)};
}

/// The rest of it: above, below, left and right of its inside.
std::array<PixelBlock, 4> borderOf(const PixelBlock& block, const PixelBlock& inside) {
    return {{{block.x_begin, block.y_begin, block.x_end, inside.y_begin},
             {block.x_begin, inside.y_end, block.x_end, block.y_end},
             {block.x_begin, inside.y_begin, inside.x_begin, inside.y_end},
             {inside.x_end, inside.y_begin, block.x_end, inside.y_end}}};
}

} // namespace

void MarkedPixels::begin(const FrameSetup& frame, int rays_per_pixel, std::size_t block_count) {
    m_twice = rays_per_pixel > rays_a_pixel;
    m_marks.resize(frame.width, frame.height);
    m_counts.assign(block_count, 0);
}

void MarkedPixels::refineInside(const FrameSetup& frame, const RayKernel& kernel,
                                const PixelBlock& block, std::size_t index) {
    m_marks.markInside(frame, kernel, block);
    PixelSmoother smoother(frame, kernel, m_twice);
    m_marks.forEach(insideOf(block, frame), [&](int x, int y) { smoother.add(x, y); });
    smoother.finish();
    m_counts[index] += smoother.count();
}

void MarkedPixels::refineBorder(const FrameSetup& frame, const RayKernel& kernel,
                                const PixelBlock& block, std::size_t index) {
    PixelSmoother smoother(frame, kernel, m_twice);
    for (const PixelBlock& side : borderOf(block, insideOf(block, frame)))
        m_marks.forEach(side, [&](int x, int y) { smoother.add(x, y); });
    smoother.finish();
    m_counts[index] += smoother.count();
}

std::size_t MarkedPixels::count() const {
    return std::accumulate(m_counts.begin(), m_counts.end(), std::size_t{0});
}

} // namespace quarn
