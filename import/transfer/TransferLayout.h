#pragma once

#include "engine/scene/MaterialTextures.h"
#include "ground/Fields.h"
#include "import/ImportedModel.h"
#include "import/assembly/MeshPlacing.h"

#include <array>
#include <cmath>
#include <cstdint>

namespace quarn {

// The fields of the description, for a FieldWriter or a FieldReader. Arrays stand elsewhere; what
// is shared is named by its place among those of its kind.

/// How often an array of the block is looked at, written and given back.
inline constexpr std::size_t TRANSFER_STEP_BYTES = std::size_t{1} << 20;
/// The last bytes of a block: the length of the description.
inline constexpr std::size_t TRANSFER_END_BYTES = 8;
/// The place that stands for no material and no texture.
inline constexpr std::int32_t NO_SHARED_PLACE = -1;

/// The numbers of elements of a mesh's arrays, in the order in which they stand in the block.
using MeshLengths = std::array<std::int32_t, 5>;

template <class Step, class AnyTexture> bool textureFields(Step step, AnyTexture& texture) {
    return step(texture.width) && step(texture.height) &&
           step(texture.wrap_u, TextureWrap::repeat, TextureWrap::clamp) &&
           step(texture.wrap_v, TextureWrap::repeat, TextureWrap::clamp) &&
           step.check(texture.width > 0 && texture.height > 0);
}

template <class Step, class AnyNumbers> bool numberFields(Step step, AnyNumbers& numbers) {
    for (auto& number : numbers)
        if (!step(number))
            return false;
    return true;
}

template <class Step, class AnyMaterial> bool surfaceFields(Step step, AnyMaterial& material) {
    return step(material.metalness) && step(material.roughness) && step(material.normal_scale) &&
           step(material.occlusion_strength) && numberFields(step, material.emission) &&
           step(material.is_one_sided) && step(material.is_unlit) && step(material.clearcoat) &&
           step(material.clearcoat_roughness) && step(material.specular) &&
           numberFields(step, material.specular_color) &&
           numberFields(step, material.sheen_color) && step(material.sheen_roughness);
}

template <class Step, class AnyMaterial> bool insideFields(Step step, AnyMaterial& material) {
    return step(material.transmission) && step(material.index_of_refraction) &&
           step(material.thickness) && step(material.attenuation_distance) &&
           numberFields(step, material.attenuation_color);
}

template <class Step, class AnyMaterial> bool placesOfTextures(Step step, AnyMaterial& material) {
    for (auto* const use : textureUses(material))
        if (!numberFields(step, use->u) || !numberFields(step, use->v))
            return false;
    return true;
}

/// All but the textures. Its numbers are any that the bytes make.
template <class Step, class AnyMaterial> bool materialFields(Step step, AnyMaterial& material) {
    return step(material.name) && step(material.base_color) && step(material.alpha_cutout) &&
           step(material.alpha_cutoff) && step(material.see_through) &&
           step.check(!(material.alpha_cutout && material.see_through)) &&
           surfaceFields(step, material) && insideFields(step, material) &&
           placesOfTextures(step, material);
}

template <class Step, class AnyLengths> bool lengthFields(Step step, AnyLengths& lengths) {
    for (auto& length : lengths)
        if (!step(length) || !step.check(length >= 0))
            return false;
    return true;
}

template <class Step, class AnyXform> bool placeFields(Step step, AnyXform& place) {
    for (auto& row : place.m_xform)
        for (auto& number : row)
            if (!step(number))
                return false;
    return step.check(place.IsValid() && place.IsAffine() && !isFlattening(place));
}

template <class Step, class AnyUp> bool upFields(Step step, AnyUp& up) {
    return step(up.axis, UpAxis::y, UpAxis::z) &&
           step(up.reason, TakenUpAxis::Reason::format, TakenUpAxis::Reason::asked);
}

template <class Step, class AnyPlace> bool earthFields(Step step, AnyPlace& place) {
    return step(place.latitude_deg) && step(place.longitude_deg) && step(place.north_angle_deg) &&
           step.check(std::abs(place.latitude_deg) <= 90.0 &&
                      std::abs(place.longitude_deg) <= 180.0 &&
                      std::isfinite(place.north_angle_deg));
}

} // namespace quarn
