#pragma once

#include "import/ModelReading.h"

namespace quarn {

/// Reads a glTF file of version 2, text or binary; older ones are left to the library.
/// @return the scene, or an error that names the file
Result<SourceScene> readGltf(const ModelReading& reading);

} // namespace quarn
