#pragma once

#include "host/document/DocumentScene.h"
#include "import/ImportedModel.h"

#include <filesystem>
#include <memory>

namespace quarn {

/// Asks the person which axis of a model points up, with a picture of each, where nothing but habit
/// says so. A model whose other axis they choose is turned.
/// @return the scene that the pictures were drawn of, which an empty document may begin with; null
///         where none was drawn
std::unique_ptr<DocumentScene> askUpAxis(const std::filesystem::path& file, ImportedModel& model);

} // namespace quarn
