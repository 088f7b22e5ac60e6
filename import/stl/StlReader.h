#pragma once

#include "import/ModelReading.h"

namespace quarn {

/// Reads an STL file (3D Systems, "StereoLithography Interface Specification", 1989), text or
/// binary, with the names of its solids and the colours that some programs keep in what the format
/// calls the attributes of a triangle. Normals are not read: they are made anew.
Result<SourceScene> readStl(const ModelReading& reading);

} // namespace quarn
