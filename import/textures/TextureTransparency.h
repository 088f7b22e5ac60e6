#pragma once

#include "engine/scene/Material.h"

namespace quarn {

/// What a texture lets through.
enum class Transparency { none, holes, partial };

/// Tells a texture of glass from one of leaves, whose holes may have soft borders.
Transparency transparencyOf(const Texture& texture);

} // namespace quarn
