#include "tests/zoetrix/RecordedPicture.h"

#include <memory>

#define STBI_ONLY_PNG
#define STB_IMAGE_STATIC
#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

RecordedPicture readPng(const std::filesystem::path& file) {
    RecordedPicture picture;
    int channels = 0;
    const std::unique_ptr<stbi_uc, decltype(&stbi_image_free)> pixels(
        stbi_load(file.c_str(), &picture.width_px, &picture.height_px, &channels, 1),
        stbi_image_free);
    if (!pixels)
        return {};
    const auto count =
        static_cast<std::size_t>(picture.width_px) * static_cast<std::size_t>(picture.height_px);
    picture.bytes.assign(pixels.get(), pixels.get() + count);
    return picture;
}
