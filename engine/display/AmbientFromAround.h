#pragma once

#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

/// Sets the ambient light and the light that the ground sends from what lies around by `frame`, so
/// that matt surfaces get what mirrors show. See AmbientLight for the source.
/// @param frame  all else of its light is known
void setAmbientFromAround(FrameSetup& frame);

} // namespace quarn
