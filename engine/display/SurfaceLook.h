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

    friend bool operator==(const SurfaceLook&, const SurfaceLook&) = default;
};

} // namespace quarn
