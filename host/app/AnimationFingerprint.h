#pragma once

#include "host/recording/RecordingFile.h"
#include "kelmar/KM_AnimationProperties.h"

namespace quarn {

class Document;

/// What decides every byte of the pictures of an animation, as it is now.
/// @param record  of the animation
RecordingFingerprint fingerprintOf(const KM_3dmAnimationProperties& record,
                                   const RecordingSettings& settings, Document& document);

} // namespace quarn
