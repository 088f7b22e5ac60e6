#pragma once

#include "import/ply/PlyHeader.h"

namespace quarn {

/// What the numbers of an element that connects vertices mean.
enum class PlyFaceRole { indices, texture, first_end, second_end, nothing };

PlyFaceRole plyFaceRole(const PlyElement& element, const PlyProperty& property);

/// True where the element has numbers of that meaning.
bool hasPlyFaceRole(const PlyElement& element, PlyFaceRole role);

} // namespace quarn
