#include "import/textures/OpacityMap.h"

#include "import/textures/DataPictures.h"

#include <cstddef>

namespace quarn {
namespace {

bool hasAlpha(const Texture& texture) {
    for (std::size_t i = 3; i < texture.rgba.size(); i += 4) {
        if (texture.rgba[i] != 255) {
            return true;
        }
    }
    return false;
}

/// Opacity is no colour: the mean of the bytes is taken as it is.
std::uint8_t opacityOf(const std::uint8_t* rgba, bool by_alpha) {
    return by_alpha ? rgba[3] : static_cast<std::uint8_t>((rgba[0] + rgba[1] + rgba[2]) / 3);
}

std::size_t nearestOffset(const Texture& texture, int x, int width, int y, int height) {
    const auto column = static_cast<std::size_t>(static_cast<long long>(x) * texture.width / width);
    const auto row = static_cast<std::size_t>(static_cast<long long>(y) * texture.height / height);
    return 4 * (row * static_cast<std::size_t>(texture.width) + column);
}

} // namespace

std::shared_ptr<Texture> withOpacity(const Texture* colors, const Texture& opacity) {
    auto both = colors != nullptr ? std::make_shared<Texture>(*colors) : whiteLike(opacity);
    const bool by_alpha = hasAlpha(opacity);
    std::uint8_t* alpha = both->rgba.data() + 3;
    for (int y = 0; y < both->height; ++y) {
        for (int x = 0; x < both->width; ++x, alpha += 4) {
            const std::size_t from = nearestOffset(opacity, x, both->width, y, both->height);
            *alpha = opacityOf(opacity.rgba.data() + from, by_alpha);
        }
    }
    return both;
}

} // namespace quarn
