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
    static constexpr int color_threshold = 14;

    /// Replaces the edge pixels in `frame.pixels`. `frame.objects` must be filled too.
    /// @param rays_per_pixel  how many more rays: 4, or 8, of which the last four are shot only
    ///   where the others saw different colours
    void refine(const FrameSetup& frame, const RayKernel& kernel, int rays_per_pixel);

    /// How many pixels the last call looked at again.
    std::size_t count() const;

private:
    /// Some rows of the picture; one list each, so that the order does not depend on threads.
    struct Band {
        std::vector<std::uint32_t> pixels; ///< offsets of the edge pixels
        std::vector<std::uint8_t> marks;   ///< of all its pixels; not 0 where an edge is
    };
    static void findBand(const FrameSetup& frame, int first_row, Band& band);

    std::vector<Band> m_bands;
};

} // namespace quarn
