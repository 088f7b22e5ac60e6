#pragma once

namespace quarn {

class MipTexture;

/// A texture as one quality of a surface uses it, see TextureUse.
struct LookTexture {
    const MipTexture* mips = nullptr; ///< null: none
    float u[3] = {1, 0, 0};
    float v[3] = {0, 1, 0};

    friend bool operator==(const LookTexture&, const LookTexture&) = default;
};

/// What textures may change from place to place: of one place, or of many together. All members are
/// of one type, so that they can be gone through like an array.
template <class Number> struct LookNumbers {
    Number occlusion; ///< the part of the sky's light that arrives
    Number emission[3];
    Number metalness;
    Number roughness;
    Number f0[3]; ///< what is mirrored where it is no metal, seen straight on
    Number f90;   ///< and along its face
    Number
        transmission;  ///< the part of what is not mirrored that goes through, where it is no metal
    Number passing[3]; ///< and what is left of it behind the surface
    Number bend;       ///< 0 to 1: how much of the roughness blurs what is seen through it
    Number clearcoat;
    Number clearcoat_roughness;

    friend bool operator==(const LookNumbers&, const LookNumbers&) = default;
};

/// Matt: it mirrors nothing.
inline constexpr LookNumbers<float> matt_look{1, {0, 0, 0}, 0, 1, {0, 0, 0}, 0,
                                              0, {0, 0, 0}, 0, 0, 0};

/// Up to the first roughness mirrors show the scene itself, from the second on what lies around.
inline constexpr float roughness_of_scene = 0.2F;
inline constexpr float roughness_of_surroundings = 0.4F;

/// What a surface looks like beyond its base colour, as the ray loops use it; see Material.
struct SurfaceLook {
    bool is_unlit = false;
    bool mirrors = false;     ///< else it scatters all light evenly
    bool shows_scene = false; ///< it mirrors most of the light, and sharply
    bool has_textures = false;
    LookNumbers<float> numbers = matt_look; ///< without the textures
    float normal_scale = 1.0F;
    float occlusion_strength = 1.0F;
    LookTexture normals;
    LookTexture occlusion;
    LookTexture emission;
    LookTexture metal_rough;
    LookTexture specular;
    LookTexture specular_color;
    LookTexture transmission;
    /// What the inside takes of light by the time it is behind the surface, as powers of e, where a
    /// texture of the thickness says how much of them counts.
    float density[3] = {0, 0, 0};
    LookTexture thickness;
    float index = 1.5F;              ///< of refraction
    bool is_thin = true;             ///< a sheet that bends no light
    float absorption[3] = {0, 0, 0}; ///< of the inside, by unit of the way, as powers of e
    LookTexture clearcoat;
    LookTexture clearcoat_roughness;
    LookTexture coat_normals;

    friend bool operator==(const SurfaceLook&, const SurfaceLook&) = default;
};

} // namespace quarn
