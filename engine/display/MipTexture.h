#pragma once

#include "engine/images/ColorSpace.h"
#include "engine/scene/Material.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// A colour and how much of it covers what lies behind.
struct TextureSample {
    LinearColor color;
    float alpha = 1.0F;
};

/// What the numbers of a texture's red, green and blue say.
enum class TexelMeaning {
    colors,  ///< sRGB
    numbers, ///< from 0 to 1 as they are
};

/// A texture with its smaller copies, each half the size of the one before down to one pixel, so
/// that a far surface shows the average of the texels under a pixel and not one of them
/// (L. Williams, "Pyramidal Parametrics", SIGGRAPH 1983).
class MipTexture {
public:
    /// @param texture  must hold its 4 * width * height bytes; one that does not is taken as white
    explicit MipTexture(const Texture& texture, TexelMeaning meaning = TexelMeaning::colors);

    /// The colour, or the numbers, at a texture coordinate, with (0, 0) at the lower left corner.
    /// @param level  0 for full size, 1 for half and so on; fractions blend two sizes
    TextureSample sample(float u, float v, float level) const;

    int width() const { return m_levels.front().width; }
    int height() const { return m_levels.front().height; }

private:
    struct Level {
        int width = 0;
        int height = 0;
        std::vector<std::uint8_t> rgba;
    };

    Level halved(const Level& larger) const;
    TextureSample texel(const std::uint8_t* rgba) const;
    TextureSample sampleLevel(const Level& level, float u, float v) const;

    std::vector<Level> m_levels;
    TextureWrap m_wrap_u;
    TextureWrap m_wrap_v;
    TexelMeaning m_meaning;
};

} // namespace quarn
