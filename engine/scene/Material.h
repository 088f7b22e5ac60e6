#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_wString.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace quarn {

/// How a texture goes on outside the square of texture coordinates from 0 to 1.
enum class TextureWrap { repeat, mirror, clamp };

/// A picture laid over a surface. Rows run from the top of the picture to its bottom; texture
/// coordinate (0, 0) is the bottom left corner.
struct Texture {
    int width = 0;                  ///< pixels
    int height = 0;                 ///< pixels
    std::vector<std::uint8_t> rgba; ///< 4 * width * height bytes, sRGB, alpha not multiplied in
    TextureWrap wrap_u = TextureWrap::repeat;
    TextureWrap wrap_v = TextureWrap::repeat;
};

/// What a surface looks like. The colour seen is base_color times the texture times the mesh's
/// vertex colours, where there are any.
struct Material {
    KM_wString name;
    KM_Color base_color{204, 204, 204, 255};           ///< sRGB
    std::shared_ptr<const Texture> base_color_texture; ///< null when there is none
    bool alpha_cutout = false; ///< leave out what is less opaque than alpha_cutoff
    float alpha_cutoff = 0.5F; ///< 0 to 1
    /// What lies behind shines through, as much as base colour, texture and vertex colours together
    /// are not opaque; does not go with alpha_cutout.
    bool see_through = false;
};

} // namespace quarn
