#pragma once

#include "engine/display/kernel/FrameSetup.h"

class KM_Viewport;

namespace quarn {

class DisplayScene;
struct DisplayModeAttributes;

/// Collects what the ray loops need for one picture: rays, surfaces, light, ground and background.
/// The outputs (pixels and so on) are left to the caller.
FrameSetup makeFrameSetup(const DisplayScene& scene, const KM_Viewport& viewport,
                          const DisplayModeAttributes& mode, int width, int height);

} // namespace quarn
