#pragma once

#include "engine/display/PixelMarks.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// Smooths the pixels of a picture in which something changes by looking at each of them more
/// often: more rays are shot through it and their colours are averaged in linear light.
///
/// A block is smoothed as soon as it is traced, while what its rays met of the scene is still at
/// hand; but for the pixels along its border, which wait until the blocks next to it are traced.
class MarkedPixels {
public:
    /// Begins a picture, of which `frame.objects` will be filled too.
    /// @param rays_per_pixel  how many more rays: 4, or 8, of which the last four are shot only
    ///   where the others saw different colours
    /// @param block_count  how many blocks the picture is traced in
    void begin(const FrameSetup& frame, int rays_per_pixel, std::size_t block_count);

    /// Smooths a block that was just traced. Different blocks may be smoothed at the same time.
    /// @param index  of the block, from 0
    void refineInside(const FrameSetup& frame, const RayKernel& kernel, const PixelBlock& block,
                      std::size_t index);

    /// Looks at the border of a block, all blocks being traced. Different blocks at the same time.
    void findAcross(const FrameSetup& frame, const RayKernel& kernel, const PixelBlock& block) {
        m_marks.markAcross(frame, kernel, block);
    }

    /// Smooths the border of a block, all borders having been looked at.
    void refineBorder(const FrameSetup& frame, const RayKernel& kernel, const PixelBlock& block,
                      std::size_t index);

    /// How many pixels of the picture were smoothed.
    std::size_t count() const;

private:
    bool m_twice = false;
    PixelMarks m_marks;
    std::vector<std::size_t> m_counts; ///< by block
};

} // namespace quarn
