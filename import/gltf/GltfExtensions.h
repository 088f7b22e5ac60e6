#pragma once

#include "import/gltf/GltfJson.h"

#include <string>

namespace quarn::gltf {

/// The first extension that a file says it cannot do without and that is not known; empty where
/// there is none. Extensions that change the looks of a surface alone need not be known.
std::string unknownExtension(const Json& json);

/// The sentence about extensions that are known and not followed: those that the file says it
/// cannot do without, and programs that stand for the looks of materials. Empty where there are
/// none.
std::string passedOverText(const Json& json);

} // namespace quarn::gltf
