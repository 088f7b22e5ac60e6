#pragma once

#include "engine/scene/Material.h"

#include <array>

namespace quarn {

/// All that may have a texture beside the base colour.
/// @param material  constant or not, as the uses then are
template <class AnyMaterial> auto textureUses(AnyMaterial& material) {
    return std::array{&material.metal_rough,
                      &material.normals,
                      &material.occlusion,
                      &material.emission_texture,
                      &material.clearcoat_texture,
                      &material.clearcoat_roughness_texture,
                      &material.clearcoat_normals,
                      &material.transmission_texture,
                      &material.thickness_texture,
                      &material.specular_texture,
                      &material.specular_color_texture};
}

} // namespace quarn
