#pragma once

#include "host/clock/Zone.h"
#include "host/recording/FramesManifest.h"
#include "kelmar/KM_AnimationProperties.h"

namespace quarn {

class Document;

/// The clocks that the frames of a sun study are told by: those of the place that the document
/// names, while the record is of that place.
/// @return nothing where it names none; the study is told by the whole hours of its longitude then
std::optional<Zone> studyZone(const Document& document, const KM_3dmAnimationProperties& record);

/// When a frame of a sun study is, and where its sun stands, as the record tells it.
/// @param frame  from 0
/// @param zone   as studyZone has it
/// @return nothing for every other animation, and where the record holds no such frame or its label
///         is no date
std::optional<FrameSun> sunOfFrame(const KM_3dmAnimationProperties& record, int frame,
                                   const std::optional<Zone>& zone);

} // namespace quarn
