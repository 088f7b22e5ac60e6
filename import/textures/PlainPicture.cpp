#include "import/textures/PlainPicture.h"

#include <algorithm>
#include <cstddef>
#include <memory>

#define STB_IMAGE_STATIC
#define STB_IMAGE_IMPLEMENTATION
#define STBI_NO_STDIO
#define STBI_ONLY_JPEG
#define STBI_ONLY_BMP
#define STBI_ONLY_TGA
#define STBI_ONLY_GIF
#include <stb_image.h>

namespace quarn {

namespace {

using Bytes = std::span<const std::uint8_t>;

struct FreePixels {
    void operator()(stbi_uc* pixels) const { stbi_image_free(pixels); }
};

std::optional<PictureSize> sizeOfPlain(Bytes file) {
    int width = 0;
    int height = 0;
    int channels = 0;
    if (stbi_info_from_memory(file.data(), static_cast<int>(file.size()), &width, &height,
                              &channels) == 0)
        return std::nullopt;
    return PictureSize{width, height};
}

bool isPlain(Bytes file) {
    return sizeOfPlain(file).has_value();
}

bool decodePlain(Bytes file, std::span<std::uint8_t> rgba) {
    int width = 0;
    int height = 0;
    int channels = 0;
    const std::unique_ptr<stbi_uc, FreePixels> pixels(stbi_load_from_memory(
        file.data(), static_cast<int>(file.size()), &width, &height, &channels, 4));
    if (pixels == nullptr || PictureSize{width, height}.bytes() != rgba.size())
        return false;
    std::copy_n(pixels.get(), rgba.size(), rgba.begin());
    return true;
}

} // namespace

const PictureFormat PLAIN_PICTURES{isPlain, sizeOfPlain, decodePlain};

} // namespace quarn
