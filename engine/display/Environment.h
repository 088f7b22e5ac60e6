#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace quarn {

/// What surfaces mirror of what lies around a scene, by their roughness: B. Karis, "Real Shading in
/// Unreal Engine 4", 2013, with each picture made from the one before, which is a little sharper.
/// What it has found it keeps while the sky, its soft lights and the ground stay as they are.
class Environment {
public:
    /// Makes the pictures of what `frame` says lies around, and lets the ray loops use them.
    void find(FrameSetup& frame, const RayKernel& kernel);

private:
    void packPairs();

    std::unique_ptr<float[]> m_light; ///< null until it is needed
    std::unique_ptr<std::uint32_t[]> m_pairs;
    std::vector<float> m_around; ///< what it was found for; empty: it is not to be kept
};

} // namespace quarn
