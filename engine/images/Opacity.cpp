#include "engine/images/Opacity.h"

namespace quarn {

namespace {

constexpr unsigned OPAQUE = 255;

std::uint8_t mixed(unsigned channel, unsigned opacity) {
    constexpr unsigned white = 255;
    const unsigned sum = channel * opacity + white * (OPAQUE - opacity);
    return static_cast<std::uint8_t>((sum + OPAQUE / 2) / OPAQUE);
}

} // namespace

bool isSeeThrough(const ImageView& picture) {
    for (std::size_t i = 3; i < picture.rgba.size(); i += 4)
        if (picture.rgba[i] != OPAQUE)
            return true;
    return false;
}

ImageView onWhite(const ImageView& picture, Image& space) {
    if (!isSeeThrough(picture))
        return picture;
    space.resize(picture.width, picture.height);
    for (std::size_t i = 0; i + 4 <= picture.rgba.size(); i += 4) {
        for (std::size_t k = 0; k < 3; ++k)
            space.rgba[i + k] = mixed(picture.rgba[i + k], picture.rgba[i + 3]);
        space.rgba[i + 3] = OPAQUE;
    }
    return space;
}

} // namespace quarn
