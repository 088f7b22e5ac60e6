#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"
#include "import/assembly/SourceScene.h"

namespace quarn {

/// Makes a model of what a reader has understood: turned so that Z points up, each mesh that stands
/// once in world coordinates, near a place of its own where it lies far from the origin, and with
/// normals; everything named.
///
/// @return the model, which may be empty; or why it cannot be made, a part of a sentence: it is too
///   large, or the person has given up
Result<ImportedModel> assembleModel(SourceScene scene, const ModelReading& reading);

} // namespace quarn
