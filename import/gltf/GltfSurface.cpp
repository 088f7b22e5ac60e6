#include "import/gltf/GltfSurface.h"

#include "engine/scene/MaterialCheck.h"

#include <algorithm>
#include <array>
#include <limits>

namespace quarn::gltf {

namespace {

constexpr LinearRgb BLACK{0.0F, 0.0F, 0.0F};

float single(double number) {
    constexpr double MOST = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(number, -MOST, MOST));
}

float factor(const Json& thing, const char* name, float otherwise) {
    return single(number(member(thing, name), double{otherwise}));
}

LinearRgb color(const Json& thing, const char* name, double otherwise, double strength = 1.0) {
    std::array<double, 3> channels{otherwise, otherwise, otherwise};
    readNumbers(member(thing, name), channels);
    return {single(channels[0] * strength), single(channels[1] * strength),
            single(channels[2] * strength)};
}

void readEmission(const Json& json, Material& material) {
    const Json& strength = extension(json, "KHR_materials_emissive_strength");
    material.emission =
        color(json, "emissiveFactor", 0.0, number(member(strength, "emissiveStrength"), 1.0));
}

/// What the older model mirrors does not depend on an index of refraction: one that mirrors all
/// leaves the colour alone, as KHR_materials_ior says of the two models.
void readGlossiness(const Json& glossiness, Material& material) {
    material.metalness = 0.0F;
    material.roughness = 1.0F - factor(glossiness, "glossinessFactor", 1.0F);
    material.specular_color = color(glossiness, "specularFactor", 1.0);
    material.index_of_refraction = MOST_INDEX_OF_REFRACTION;
}

void readCoat(const Json& json, Material& material) {
    const Json& coat = extension(json, "KHR_materials_clearcoat");
    material.clearcoat = factor(coat, "clearcoatFactor", 0.0F);
    material.clearcoat_roughness = factor(coat, "clearcoatRoughnessFactor", 0.0F);
    const Json& sheen = extension(json, "KHR_materials_sheen");
    material.sheen_color = color(sheen, "sheenColorFactor", 0.0);
    material.sheen_roughness = factor(sheen, "sheenRoughnessFactor", 0.0F);
}

void readGlass(const Json& json, Material& material) {
    const Json& transmission = extension(json, "KHR_materials_transmission");
    material.transmission = factor(transmission, "transmissionFactor", 0.0F);
    const Json& volume = extension(json, "KHR_materials_volume");
    material.thickness = factor(volume, "thicknessFactor", 0.0F);
    if (const Json& distance = member(volume, "attenuationDistance"); distance.is_number())
        material.attenuation_distance = single(distance.get<double>());
    material.attenuation_color = color(volume, "attenuationColor", 1.0);
}

/// An index of refraction of 0 is the extension's word for a surface that mirrors all, where the
/// colour of what it mirrors is stated beside it.
void readMirroring(const Json& json, Material& material) {
    const Json& refraction = extension(json, "KHR_materials_ior");
    const Json& specular = extension(json, "KHR_materials_specular");
    material.index_of_refraction = factor(refraction, "ior", material.index_of_refraction);
    if (material.index_of_refraction == 0.0F && !specular.is_null())
        material.index_of_refraction = MOST_INDEX_OF_REFRACTION;
    material.specular = factor(specular, "specularFactor", 1.0F);
    material.specular_color = color(specular, "specularColorFactor", 1.0);
}

} // namespace

const Json& glossinessOf(const Json& material) {
    return extension(material, "KHR_materials_pbrSpecularGlossiness");
}

void readSurface(const Json& json, Material& material) {
    const Json& metal_rough = member(json, "pbrMetallicRoughness");
    material.metalness = factor(metal_rough, "metallicFactor", 1.0F);
    material.roughness = factor(metal_rough, "roughnessFactor", 1.0F);
    material.normal_scale = factor(member(json, "normalTexture"), "scale", 1.0F);
    material.occlusion_strength = factor(member(json, "occlusionTexture"), "strength", 1.0F);
    material.is_one_sided = !flag(member(json, "doubleSided"));
    material.is_unlit = extension(json, "KHR_materials_unlit").is_object();
    readEmission(json, material);
    readCoat(json, material);
    readGlass(json, material);
    readMirroring(json, material);
    if (const Json& glossiness = glossinessOf(json); !glossiness.is_null())
        readGlossiness(glossiness, material);
}

std::vector<SurfaceTexture> surfaceTextures(const Json& json, const Material& material) {
    std::vector<SurfaceTexture> textures;
    const auto add = [&textures](const Json& thing, const char* member_name,
                                 TextureUse Material::*use, const char* name) {
        textures.push_back({&member(thing, member_name), use, name});
    };
    if (material.is_unlit)
        return textures;
    if (glossinessOf(json).is_null())
        add(member(json, "pbrMetallicRoughness"), "metallicRoughnessTexture",
            &Material::metal_rough, "metalness and roughness");
    add(json, "normalTexture", &Material::normals, "normal map");
    add(json, "occlusionTexture", &Material::occlusion, "occlusion");
    if (material.emission != BLACK)
        add(json, "emissiveTexture", &Material::emission_texture, "emission");
    if (const Json& coat = extension(json, "KHR_materials_clearcoat"); material.clearcoat != 0.0F) {
        add(coat, "clearcoatTexture", &Material::clearcoat_texture, "clearcoat");
        add(coat, "clearcoatRoughnessTexture", &Material::clearcoat_roughness_texture,
            "clearcoat roughness");
        add(coat, "clearcoatNormalTexture", &Material::clearcoat_normals, "clearcoat normal map");
    }
    if (material.transmission != 0.0F)
        add(extension(json, "KHR_materials_transmission"), "transmissionTexture",
            &Material::transmission_texture, "transmission");
    if (material.thickness != 0.0F)
        add(extension(json, "KHR_materials_volume"), "thicknessTexture",
            &Material::thickness_texture, "thickness");
    if (const Json& specular = extension(json, "KHR_materials_specular");
        glossinessOf(json).is_null()) {
        add(specular, "specularTexture", &Material::specular_texture, "specular");
        add(specular, "specularColorTexture", &Material::specular_color_texture, "specular colour");
    }
    return textures;
}

} // namespace quarn::gltf
