#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"

namespace quarn {

/// Reads a file of a format that has no reader of its own here.
/// @return the scene, or an error that names the file
Result<SourceScene> readWithLibrary(const ModelReading& reading);

} // namespace quarn
