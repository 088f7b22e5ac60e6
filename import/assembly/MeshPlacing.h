#pragma once

#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Xform.h"

#include <cstddef>

namespace quarn {

/// True for a coordinate that a mesh can hold: a number of single precision. Whether it can be
/// drawn is another question, see engine/scene/DrawableRange.h.
bool isUsableCoordinate(double coordinate);

/// A transform without an inverse: what it makes cannot be shared.
bool isFlattening(const KM_Xform& xform);

/// Moves a mesh by a matrix that may also flatten it, which KM_Mesh::Transform refuses. One that
/// mirrors turns the triangles round, so that their outside stays outside. Normals stay unit
/// vectors or become zero; triangles with a vertex that would leave single precision are taken
/// away.
/// @return how many triangles were
std::size_t placeMesh(KM_Mesh& mesh, const KM_Xform& xform);

/// Gives each vertex that has none its normal, and releases memory that was only kept in reserve.
void completeMesh(KM_Mesh& mesh);

/// False when the corners of each triangle lie on a line or at one place, but for rounding.
bool hasArea(const KM_Mesh& mesh);

} // namespace quarn
