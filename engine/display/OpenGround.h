#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// How much of the light from all around arrives at the ground under a scene: soft shadows of all
/// that stands on it. It is found once, on a map of the ground, and kept while surfaces and light
/// stay as they are: a camera that moves costs nothing. All places look in the same directions, the
/// more of them toward where the more light comes from, so there is no noise.
class OpenGround {
public:
    /// Finds the map of `frame`, if it is not known yet, and lets the ray loops use it.
    /// @param frame            its ground and all its light are known
    /// @param surfaces_number  another one whenever the scene's surfaces are others
    /// @param directions       how many it looks in, up to ground_directions: more of them make
    ///   smoother shadows and take longer
    void find(FrameSetup& frame, const RayKernel& kernel, std::uint64_t surfaces_number,
              int directions);

private:
    std::vector<float> m_open;
    std::uint64_t m_surfaces_number = 0;
    FrameGroundMap m_map;
    GroundDirections m_directions;
};

} // namespace quarn
