#pragma once

#include "host/document/DocumentScene.h"
#include "import/ImportedModel.h"

#include <filesystem>

namespace quarn {

/// Asks the person which axis of a model points up, with a picture of each, where nothing but habit
/// says so. A model whose other axis they choose is turned.
/// @param built  a scene of the model as it was read, so that its large meshes need not be built
///               again; may be null
void askUpAxis(const std::filesystem::path& file, ImportedModel& model, const DocumentScene* built);

} // namespace quarn
