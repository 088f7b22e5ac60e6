#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <vector>

namespace quarn {

/// How much of the sky each part of a picture is open to: dark corners, and soft shadows where
/// things stand on each other.
///
/// It is found on a grid with half as many places in a row as the picture has pixels. Each place
/// looks in a few directions, other ones than its neighbours, and the mean over four by four places
/// of one surface has looked in all: so there is no noise, and the same picture comes out for any
/// number of threads. It keeps its buffers from picture to picture.
class FreeSky {
public:
    /// Looks at all places as far as `frame.sky_reach` and lets the ray loops use what was found.
    void find(FrameSetup& frame, const RayKernel& kernel);

private:
    /// From the first to the last place of a mean, counted from the place that takes it.
    struct Span {
        int first;
        int last;
    };
    void smooth(const FrameSetup& frame, int dx, int dy, Span span);

    std::vector<SkyPlace> m_places;
    std::vector<float> m_free;
    std::vector<float> m_smoothed;
};

} // namespace quarn
