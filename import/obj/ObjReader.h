#pragma once

#include "import/ModelReading.h"
#include "import/assembly/SourceScene.h"

namespace quarn {

/// Reads an OBJ file with its material files. docs/model-files.md says what is kept. What cannot be
/// understood or names nothing is left out and told with its line.
/// @return an error that names the file where the reading was given up or takes too much memory
Result<SourceScene> readObj(const ModelReading& reading);

} // namespace quarn
