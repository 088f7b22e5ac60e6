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

/// What a surface looks like beyond its base colour, as the ray loops use it; see Material.
struct SurfaceLook {
    bool is_unlit = false;
    bool has_textures = false;
    float emission[3] = {0, 0, 0};
    LookTexture emission_texture;
    bool mirrors = false;    ///< else it scatters all light evenly
    float f0[3] = {0, 0, 0}; ///< what is mirrored where it is no metal, seen straight on
    float f90 = 1.0F;        ///< and along its face
    float metalness = 0.0F;
    float roughness = 1.0F;
    LookTexture metal_rough;

    friend bool operator==(const SurfaceLook&, const SurfaceLook&) = default;
};

} // namespace quarn
