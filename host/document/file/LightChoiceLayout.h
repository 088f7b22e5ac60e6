#pragma once

#include "host/document/LightChoice.h"
#include "kelmar/KM_BinaryArchive.h"

namespace quarn {

// The payload of the chunk of what a scene is lit by beside its lights. Both return false, with the
// archive failed, when it cannot be written or cannot be part of a document.

bool writeLightChoice(KM_BinaryArchive& archive, const LightChoice& choice);
/// Passes over what a newer minor layout has behind what is known.
bool readLightChoice(KM_BinaryArchive& archive, LightChoice& choice);

} // namespace quarn
