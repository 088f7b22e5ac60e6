#pragma once

#include "engine/display/SkyModel.h"

namespace quarn {

/// How much of its light the floor of a studio sends back.
inline constexpr float STUDIO_FLOOR_ALBEDO = 0.78F;

/// What lies around in a studio for taking pictures of products: grey walls and soft boxes, a large
/// one overhead, the key light at the upper left of a front view, a fill light at the right and a
/// rim light behind. It stands still in the world. There is no sun, and the light that it sheds is
/// not in it: that follows from what is seen here.
Lighting productStudio();

/// Its seamless backdrop, as it is shown under an exposure of 1, from the top of pictures to their
/// bottom. The floor looks as the backdrop does.
inline constexpr KM_Color STUDIO_BACKDROP_TOP{218, 220, 223, 255};
inline constexpr KM_Color STUDIO_BACKDROP_BOTTOM{238, 238, 238, 255};

} // namespace quarn
