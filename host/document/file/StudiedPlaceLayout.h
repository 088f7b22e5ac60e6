#pragma once

#include "host/document/StudiedPlace.h"
#include "kelmar/KM_BinaryArchive.h"

namespace quarn {

// The payload of the chunk of the place that a sun study is of. Both return false, with the archive
// failed, when it cannot be written or cannot be part of a document.

bool writeStudiedPlace(KM_BinaryArchive& archive, const StudiedPlace& place);
/// Passes over what a newer minor layout has behind what is known.
bool readStudiedPlace(KM_BinaryArchive& archive, StudiedPlace& place);

} // namespace quarn
