#pragma once

#include "engine/scene/Material.h"

#include <memory>

namespace quarn {

/// A picture with the colours of one texture and the opacity that another gives: its alpha where it
/// has any, else its brightness, as material files of OBJ use it. It has the size and the wrap
/// modes of the colours; where there are none it is white and takes those of the opacity.
/// @param colors   may be null
/// @param opacity  whole: as many bytes as its size says
std::shared_ptr<Texture> withOpacity(const Texture* colors, const Texture& opacity);

} // namespace quarn
