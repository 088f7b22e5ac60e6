#pragma once

#include "engine/scene/MaterialTextures.h"

namespace quarn {

/// Calls `step(name, quality)` with each quality of a material beyond its base colour and what of
/// it is left out or shines through, in the order in which documents keep them, while it returns
/// true. A quality is a float, a bool, a LinearRgb or a TextureUse. One list serves all who keep,
/// tell or compare materials, so that none forgets one.
/// @return false as soon as a step does
template <class Step, class AnyMaterial> bool qualityFields(Step step, AnyMaterial& material) {
    // A member that is added has to be taken along: this line says so.
    [[maybe_unused]] auto& [name, base_color, base_color_texture, alpha_cutout, alpha_cutoff,
                            see_through, metalness, roughness, metal_rough, normals, normal_scale,
                            occlusion, occlusion_strength, emission, emission_texture, is_one_sided,
                            is_unlit, clearcoat, clearcoat_roughness, clearcoat_texture,
                            clearcoat_roughness_texture, clearcoat_normals, transmission,
                            transmission_texture, index_of_refraction, thickness, thickness_texture,
                            attenuation_distance, attenuation_color, specular, specular_color,
                            specular_texture, specular_color_texture, sheen_color,
                            sheen_roughness] = material;
    return step("metalness", metalness) && step("roughness", roughness) &&
           step("metal_rough", metal_rough) && step("normals", normals) &&
           step("normal_scale", normal_scale) && step("occlusion", occlusion) &&
           step("occlusion_strength", occlusion_strength) && step("emission", emission) &&
           step("emission_texture", emission_texture) && step("one_sided", is_one_sided) &&
           step("unlit", is_unlit) && step("clearcoat", clearcoat) &&
           step("clearcoat_roughness", clearcoat_roughness) &&
           step("clearcoat_texture", clearcoat_texture) &&
           step("clearcoat_roughness_texture", clearcoat_roughness_texture) &&
           step("clearcoat_normals", clearcoat_normals) && step("transmission", transmission) &&
           step("transmission_texture", transmission_texture) &&
           step("index_of_refraction", index_of_refraction) && step("thickness", thickness) &&
           step("thickness_texture", thickness_texture) &&
           step("attenuation_distance", attenuation_distance) &&
           step("attenuation_color", attenuation_color) && step("specular", specular) &&
           step("specular_color", specular_color) && step("specular_texture", specular_texture) &&
           step("specular_color_texture", specular_color_texture) &&
           step("sheen_color", sheen_color) && step("sheen_roughness", sheen_roughness);
}

/// Calls `visit` with the shared pointer to each texture that a material has; one that serves
/// several qualities comes several times.
template <class Visit> void forEachTexture(const Material& material, Visit visit) {
    if (material.base_color_texture)
        visit(material.base_color_texture);
    for (const TextureUse* use : textureUses(material))
        if (use->texture)
            visit(use->texture);
}

} // namespace quarn
