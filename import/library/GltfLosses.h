#pragma once

#include "import/library/GltfDescription.h"

struct aiScene;

namespace quarn {

/// Sentences about the faces that the reading library left out of a glTF scene because an index of
/// theirs lies beyond the vertices; which it does without a word.
/// @param scene  as it was read, before any step changed its meshes
std::vector<std::string> tellLostFaces(const aiScene& scene, const GltfDescription& description);

} // namespace quarn
