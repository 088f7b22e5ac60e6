#include "import/textures/TextureTransparency.h"

namespace quarn {

Transparency transparencyOf(const Texture& texture) {
    constexpr std::size_t border_share = 10;
    std::size_t clear = 0;
    std::size_t partial = 0;
    for (std::size_t i = 3; i < texture.rgba.size(); i += 4) {
        const std::uint8_t alpha = texture.rgba[i];
        clear += alpha < 16 ? 1 : 0;
        partial += alpha >= 16 && alpha < 240 ? 1 : 0;
    }
    if (clear == 0 && partial == 0)
        return Transparency::none;
    return partial * border_share > texture.rgba.size() / 4 ? Transparency::partial
                                                            : Transparency::holes;
}

} // namespace quarn
