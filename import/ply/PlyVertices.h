#pragma once

#include "import/ply/PlyContents.h"
#include "kelmar/KM_Mesh.h"

#include <cstdint>

namespace quarn {

/// The vertices of a file, each in its place; those of coordinates that are no usable numbers have
/// a place that is none.
struct PlyVertices {
    KM_Mesh mesh; ///< without triangles
    KM_3dPoint origin;
    std::uint64_t unusable = 0;
};

/// Reads the element "vertex". What is wrong is noted in `contents`.
/// @param kind  which of the elements that is
PlyVertices readPlyVertices(PlyContents& contents, std::size_t kind);

} // namespace quarn
