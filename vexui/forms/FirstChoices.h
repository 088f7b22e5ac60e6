#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/vexui/VexUi.h"
#include "vexui/forms/RecordingFields.h"

namespace vexui {

/// Where no animation was ever set up in a document, its record names no view, and the lists select
/// their first entries: a picture from above, and the slowest renderer. Then the form offers what
/// the person is looking at instead: the active view, drawn as it is drawn now.
void offerWhatIsSeen(const RecordingFields& fields, const IZoetrixDataUI& lists,
                     const KM_3dmAnimationProperties& record);

} // namespace vexui
