#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <memory>

namespace quarn {

/// What surfaces mirror of what lies around a scene, by their roughness: B. Karis, "Real Shading in
/// Unreal Engine 4", 2013, with each picture made from the one before, which is a little sharper.
/// It keeps its buffer from picture to picture.
class Environment {
public:
    /// Makes the pictures of what `frame` says lies around, and lets the ray loops use them.
    void find(FrameSetup& frame, const RayKernel& kernel);

private:
    std::unique_ptr<float[]> m_light; ///< null until it is needed
};

} // namespace quarn
