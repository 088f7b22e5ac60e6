#pragma once

namespace quarn {

/// Where a texture coordinate of a mesh lies on the texture: u' = u[0] u + u[1] v + u[2], and v'
/// with the numbers of v.
struct TexturePlace {
    double u[3] = {1, 0, 0};
    double v[3] = {0, 1, 0};
};

} // namespace quarn
