#include "import/library/SurfaceNumbers.h"

#include "import/assembly/OlderLooks.h"

#include <assimp/material.h>

namespace quarn {

namespace {

LinearRgb channelsOf(const aiColor3D& color) {
    return {color.r, color.g, color.b};
}

/// @return false where neither is stated
bool readMetalAndRoughness(const aiMaterial& source, Material& material) {
    const bool has_metalness =
        source.Get(AI_MATKEY_METALLIC_FACTOR, material.metalness) == aiReturn_SUCCESS;
    const bool has_roughness =
        source.Get(AI_MATKEY_ROUGHNESS_FACTOR, material.roughness) == aiReturn_SUCCESS;
    return has_metalness || has_roughness;
}

/// The library fills in highlights and exponents where the file's way of shading has none.
bool mayHaveHighlight(const aiMaterial& source) {
    int shading = aiShadingMode_Phong;
    source.Get(AI_MATKEY_SHADING_MODEL, shading);
    return shading == aiShadingMode_Phong || shading == aiShadingMode_Blinn ||
           shading == aiShadingMode_CookTorrance || shading == aiShadingMode_Fresnel;
}

void readHighlight(const aiMaterial& source, Material& material) {
    aiColor3D color(0.0F, 0.0F, 0.0F);
    float exponent = 0.0F;
    source.Get(AI_MATKEY_COLOR_SPECULAR, color);
    source.Get(AI_MATKEY_SHININESS, exponent);
    if (!mayHaveHighlight(source) || color.IsBlack() || !(exponent > 0.0F))
        return;
    material.roughness = roughnessOfExponent(exponent);
    setHighlight(material, channelsOf(color));
}

} // namespace

void readSurfaceNumbers(const aiMaterial& source, Material& material) {
    if (!readMetalAndRoughness(source, material))
        readHighlight(source, material);
    aiColor3D light(0.0F, 0.0F, 0.0F);
    source.Get(AI_MATKEY_COLOR_EMISSIVE, light);
    float intensity = 1.0F;
    source.Get(AI_MATKEY_EMISSIVE_INTENSITY, intensity);
    material.emission = lightOfColor(channelsOf(light * intensity));
}

} // namespace quarn
