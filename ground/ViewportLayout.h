#pragma once

#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Viewport.h"

namespace quarn {

/// @return false, with the archive failed, also for a camera that is not valid
bool writeViewport(KM_BinaryArchive& archive, const KM_Viewport& viewport);

/// Reads a viewport, to the last bit.
/// @return false, with the archive failed and `viewport` unchanged, when there is no valid one
bool readViewport(KM_BinaryArchive& archive, KM_Viewport& viewport);

} // namespace quarn
