#pragma once

#include "import/assembly/SourceScene.h"

#include <string>

namespace quarn {

/// The sentence for a scene whose meshes, in single precision, lie so far from the origin that one
/// sees how their coordinates are rounded; empty where one does not.
std::string roundingText(const SourceScene& scene);

} // namespace quarn
