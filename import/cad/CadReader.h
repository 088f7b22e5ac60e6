#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"

namespace quarn {

/// Readers of files of curved surfaces. Their meshes lie as near to the surfaces as
/// ReadingOptions::tolerance says; STEP and IGES come out in millimetres.
/// @return the scene, or an error that names the file; also where the module that reads them is not
///   there
Result<SourceScene> readStep(const ModelReading& reading);
Result<SourceScene> readIges(const ModelReading& reading);
Result<SourceScene> readBrep(const ModelReading& reading);

} // namespace quarn
