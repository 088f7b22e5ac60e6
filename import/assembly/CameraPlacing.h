#pragma once

#include "import/ImportedModel.h"
#include "import/assembly/SourceScene.h"
#include "kelmar/KM_BoundingBox.h"

#include <optional>

namespace quarn {

/// A camera of a file as the document knows cameras.
/// @param bounds  of the model; the target lies where the line of sight comes closest to its middle
/// @return nothing for a camera without a place or a direction
std::optional<ImportedCamera> placeCamera(const SourceCamera& camera, const KM_BoundingBox& bounds);

} // namespace quarn
