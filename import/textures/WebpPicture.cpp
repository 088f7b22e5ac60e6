#include "import/textures/WebpPicture.h"

#include <webp/decode.h>

#include <cstring>

namespace quarn {

namespace {

using Bytes = std::span<const std::uint8_t>;

bool isWebp(Bytes file) {
    return file.size() >= 12 && std::memcmp(file.data(), "RIFF", 4) == 0 &&
           std::memcmp(file.data() + 8, "WEBP", 4) == 0;
}

std::optional<PictureSize> sizeOfWebp(Bytes file) {
    int width = 0;
    int height = 0;
    if (WebPGetInfo(file.data(), file.size(), &width, &height) == 0)
        return std::nullopt;
    return PictureSize{width, height};
}

bool decodeWebp(Bytes file, std::span<std::uint8_t> rgba) {
    const std::optional<PictureSize> size = sizeOfWebp(file);
    return size && size->bytes() == rgba.size() &&
           WebPDecodeRGBAInto(file.data(), file.size(), rgba.data(), rgba.size(),
                              static_cast<int>(4 * size->width)) != nullptr;
}

} // namespace

const PictureFormat WEBP_PICTURES{isWebp, sizeOfWebp, decodeWebp};

} // namespace quarn
