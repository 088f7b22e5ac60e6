#pragma once

#include "import/ModelReading.h"

#include <string_view>

namespace quarn {

/// True for a file whose length is the one that its count of triangles asks for: it is binary,
/// however it begins.
bool hasBinaryStlLength(std::string_view file);

/// Reads a binary file. Colours are those of two conventions: where the header states the colour
/// of the whole as "COLOR=" and four bytes, triangles whose fifteenth bit is not set have their
/// own, red lowest; elsewhere those whose fifteenth bit is set, blue lowest.
Result<SourceScene> readBinaryStl(const ModelReading& reading);

} // namespace quarn
