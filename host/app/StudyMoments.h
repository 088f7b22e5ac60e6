#pragma once

#include "host/recording/FramesManifest.h"
#include "kelmar/KM_AnimationProperties.h"

namespace quarn {

/// When a frame of a sun study is, and where its sun stands, as the record tells it.
/// @param frame  from 0
/// @return nothing for every other animation, and where the record holds no such frame or its label
///         is no date
std::optional<FrameSun> sunOfFrame(const KM_3dmAnimationProperties& record, int frame);

} // namespace quarn
