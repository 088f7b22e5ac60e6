#pragma once

#include "tests/engine/display/DisplayFixture.h"

#include "engine/scene/Material.h"

#include <functional>

namespace quarn {

/// Adds a mesh object of a material that `change` makes; gives back its index.
std::size_t addLook(SceneContent& content, KM_Mesh mesh,
                    const std::function<void(Material&)>& change);

/// A rectangle that stands upright, seen along y: x from x0 to x1, z from 0 to `height`, with
/// texture coordinates from 0 to 1.
KM_Mesh wallMesh(float x0, float x1, float y, float height);

/// A texture of one column of texels a call: texel(x, y) gives red, green, blue and alpha.
std::shared_ptr<const Texture>
textureOf(int width, int height, const std::function<std::array<std::uint8_t, 4>(int, int)>& texel);

/// Writes a picture into the folder that QUARN_PICTURES names, if it does: to be looked at.
void show(const Image& image, const char* name);

} // namespace quarn
