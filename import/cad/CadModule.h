#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"

namespace quarn {

enum class CadFormat { step, iges, brep };

/// What the module that reads files of curved surfaces exports, under this name. It is built with
/// the program and opened only when such a file comes, because its libraries are large. No
/// exception leaves it.
/// @param scene  receives the scene, or an error that names the file
using ReadCad = void (*)(const ModelReading& reading, CadFormat format, Result<SourceScene>& scene);
constexpr const char* READ_CAD_NAME = "quarnReadCad";

} // namespace quarn
