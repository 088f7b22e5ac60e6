#pragma once

#include "engine/scene/Material.h"
#include "import/gltf/GltfJson.h"

#include <vector>

namespace quarn::gltf {

/// A texture of a material beside that of its base colour.
struct SurfaceTexture {
    const Json* reference; ///< JSON; never null
    TextureUse Material::*use;
    const char* name; ///< for a person
};

/// The extension of the older model, of diffuse colour and glossiness; null where the material has
/// none.
const Json& glossinessOf(const Json& material);

/// Sets what the numbers of a material say, but for base colour and opacity, which need its
/// texture. Khronos Group, glTF 2.0, section 3.9 and 5.19, and the extensions
/// KHR_materials_clearcoat, emissive_strength, ior, pbrSpecularGlossiness, sheen, specular,
/// transmission, unlit, volume. Numbers may be out of range afterwards.
/// @param json  null: the default material
void readSurface(const Json& json, Material& material);

/// The textures of a material that have a part in its looks: none for what it has nothing of.
std::vector<SurfaceTexture> surfaceTextures(const Json& json, const Material& material);

} // namespace quarn::gltf
