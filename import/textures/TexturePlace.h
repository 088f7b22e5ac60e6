#pragma once

#include "engine/scene/Material.h"

namespace quarn {

/// Where a texture coordinate of a file lies on the texture: u' = u[0] u + u[1] v + u[2], and v'
/// with the numbers of v. Both v' run upward from the lower border.
struct TexturePlace {
    double u[3] = {1, 0, 0};
    double v[3] = {0, 1, 0};

    friend bool operator==(const TexturePlace&, const TexturePlace&) = default;
};

/// Says where a texture lies on a mesh.
/// @param mesh   what has made the mesh's coordinates of those of the file
/// @param place  the texture's own place, by the coordinates of the file
/// @param use    gets the place by the mesh's coordinates
/// @return false, with nothing changed, where the mesh's coordinates lie on a line or at a point:
///   what they were made of cannot be told any more
bool layTexture(const TexturePlace& mesh, const TexturePlace& place, TextureUse& use);

} // namespace quarn
