#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_wString.h"

#include <array>
#include <cstdint>
#include <limits>
#include <memory>
#include <vector>

namespace quarn {

/// How a texture goes on outside the square of texture coordinates from 0 to 1.
enum class TextureWrap { repeat, mirror, clamp };

/// A picture laid over a surface. Rows run from the top of the picture to its bottom; texture
/// coordinate (0, 0) is the bottom left corner.
struct Texture {
    int width = 0;  ///< pixels
    int height = 0; ///< pixels
    /// 4 * width * height bytes: colours in sRGB, alpha not multiplied in; or numbers from 0 to 1
    /// as they are (roughness, normals, ...), by what uses it.
    std::vector<std::uint8_t> rgba;
    TextureWrap wrap_u = TextureWrap::repeat;
    TextureWrap wrap_v = TextureWrap::repeat;
};

/// A texture as one quality of a surface uses it. The mesh's coordinates (u, v) lie at
/// (u[0] u + u[1] v + u[2], v[0] u + v[1] v + v[2]) on it; those of the base colour are the mesh's
/// own.
struct TextureUse {
    std::shared_ptr<const Texture> texture; ///< null when there is none
    std::array<float, 3> u{1, 0, 0};
    std::array<float, 3> v{0, 1, 0};

    friend bool operator==(const TextureUse&, const TextureUse&) = default;
};

/// A colour in linear light; its numbers may be above 1 where it is light.
using LinearRgb = std::array<float, 3>;

/// What a surface looks like: the metallic-roughness model of glTF 2.0 (Khronos Group, "glTF 2.0
/// Specification", 2021, 3.9 and appendix B) and of its ratified extensions that are named here.
/// Each number is multiplied by its texture's channel, where there is one. A surface is seen from
/// both sides unless it is told otherwise. Numbers are finite and within what is said here.
struct Material {
    KM_wString name;
    /// sRGB; the colour seen is this times the texture times the mesh's vertex colours, where there
    /// are any.
    KM_Color base_color{204, 204, 204, 255};
    std::shared_ptr<const Texture> base_color_texture; ///< null when there is none
    bool alpha_cutout = false; ///< leave out what is less opaque than alpha_cutoff
    float alpha_cutoff = 0.5F; ///< 0 to 1
    /// What lies behind shines through, as much as base colour, texture and vertex colours together
    /// are not opaque; does not go with alpha_cutout.
    bool see_through = false;

    float metalness = 0.0F; ///< 0 to 1
    float roughness = 1.0F; ///< 0 to 1, perceptual: its square is the width of the highlight
    TextureUse metal_rough; ///< numbers: green is roughness, blue is metalness
    TextureUse normals;     ///< numbers: x, y, z from -1 to 1 in the frame of the coordinates
    float normal_scale = 1.0F;
    TextureUse occlusion;            ///< numbers: red is how much of the sky's light arrives
    float occlusion_strength = 1.0F; ///< 0 to 1
    LinearRgb emission{0, 0, 0};     ///< from 0, its strength multiplied in
    TextureUse emission_texture;     ///< colours
    bool is_one_sided = false;       ///< its back is not seen
    bool is_unlit = false;           ///< shows its base colour whatever the light (unlit)

    float clearcoat = 0.0F; ///< 0 to 1: how much of the surface is under a clear coat
    float clearcoat_roughness = 0.0F;
    TextureUse clearcoat_texture;           ///< numbers: red
    TextureUse clearcoat_roughness_texture; ///< numbers: green
    TextureUse clearcoat_normals;           ///< numbers, as normals

    float transmission = 0.0F; ///< 0 to 1: how much of the light that is not mirrored goes through
    TextureUse transmission_texture;  ///< numbers: red
    float index_of_refraction = 1.5F; ///< from 1
    float thickness = 0.0F;           ///< in units of the mesh; 0: thin, it does not bend light
    TextureUse thickness_texture;     ///< numbers: green
    /// Of what is inside: the distance, in units of the mesh, after which white light has the
    /// colour; infinite: it takes no light.
    float attenuation_distance = std::numeric_limits<float>::infinity();
    LinearRgb attenuation_color{1, 1, 1};

    float specular = 1.0F;             ///< 0 to 1: strength of the mirroring of what is no metal
    LinearRgb specular_color{1, 1, 1}; ///< its colour when seen straight on, from 0
    TextureUse specular_texture;       ///< numbers: alpha
    TextureUse specular_color_texture; ///< colours

    LinearRgb sheen_color{0, 0, 0}; ///< kept, not drawn
    float sheen_roughness = 0.0F;   ///< kept, not drawn
};

} // namespace quarn
