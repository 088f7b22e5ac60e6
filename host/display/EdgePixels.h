#pragma once

#include "host/display/kernel/FrameSetup.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// Smooths the pixels in which something changes by looking at each of them more often.
///
/// Where a pixel differs from one of its four neighbours in colour or object (which every visible
/// step of normal or depth brings with it), more rays are shot through it and their colours are
/// averaged in linear light.
class EdgePixels {
public:
    /// How visible a change of colour must be, in steps of a channel's 255.
    static constexpr int color_threshold = 12;

    /// Replaces the edge pixels in `frame.pixels`. `frame.objects` must be filled too.
    /// @param rays_per_pixel  how many more rays: 4 or 8
    void refine(const FrameSetup& frame, const RayKernel& kernel, int rays_per_pixel);

    /// How many pixels the last call looked at again.
    std::size_t count() const;

private:
    /// Some rows of the picture; one list each, so that the order does not depend on threads.
    struct Band {
        std::vector<std::uint32_t> pixels; ///< offsets of the edge pixels
        std::vector<std::uint32_t> marks;  ///< not 0 where the row at hand has an edge
    };
    static void findRow(const FrameSetup& frame, int row, Band& band);

    std::vector<Band> m_bands;
};

} // namespace quarn
