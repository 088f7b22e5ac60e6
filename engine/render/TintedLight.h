#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <embree3/rtcore.h>

namespace quarn {

/// The context of occlusion rays that see-through surfaces only dim and colour. The id of such a
/// ray is its place in `passed` plus `first_tinted_id`.
struct TintedLight {
    RTCIntersectContext context; ///< first: rays are shot with its address
    const FrameSetup* frame;
    float passed[3][lane_count]; ///< what comes through of each channel
};

/// Other occlusion rays have lower ids, see PassingLight.
inline constexpr unsigned first_tinted_id = 17;

/// How much of one channel comes through a see-through surface: as much as it is not opaque, and
/// of the other colours than its own less, the more opaque it is. So the shadow of a pane of grey
/// glass is as dark as in Rendered mode, and that of a red one is reddish.
/// @param hue  the channel of the base colour, as a part of its brightest one
float passedByPane(float opacity, float hue);

/// Makes sixteen rays pass the see-through surfaces of `frame`, which has to stay while they fly.
void startTintedLight(const FrameSetup& frame, TintedLight& light, RTCRay16& rays);

} // namespace quarn
