#pragma once

#include "import/ModelReading.h"
#include "import/assembly/SourceScene.h"

namespace quarn {

/// Reads an OFF file. docs/model-files.md says what is kept.
/// @return an error that names the file and the line that is damaged; or where the file is cut
///   short or binary, the reading was given up or takes too much memory
Result<SourceScene> readOff(const ModelReading& reading);

} // namespace quarn
