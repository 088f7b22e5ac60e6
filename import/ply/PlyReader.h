#pragma once

#include "import/ModelReading.h"

namespace quarn {

/// Reads a PLY file (G. Turk, "The PLY Polygon File Format", 1994), text or binary: vertices with
/// normals, colours and texture coordinates, polygons, strips of triangles, edges, and the texture
/// that a comment names. Elements of other kinds are passed over.
Result<SourceScene> readPly(const ModelReading& reading);

} // namespace quarn
