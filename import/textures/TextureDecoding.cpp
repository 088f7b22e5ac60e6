#include "import/textures/TextureDecoding.h"

#include "ground/FileBytes.h"

#include <memory>
#include <string_view>

#define STB_IMAGE_STATIC
#define STB_IMAGE_IMPLEMENTATION
#define STBI_NO_STDIO
#define STBI_ONLY_PNG
#define STBI_ONLY_JPEG
#define STBI_ONLY_BMP
#define STBI_ONLY_TGA
#define STBI_ONLY_GIF
#define STBI_MAX_DIMENSIONS 16384
#include <stb_image.h>

namespace quarn {
namespace {

constexpr std::int64_t most_pixels = 64LL << 20;
constexpr std::uintmax_t most_bytes = 256ULL << 20;

constexpr const char* too_large =
    "it is too large: more than 64 million pixels, or more than 16384 in a row";

struct FreePixels {
    void operator()(stbi_uc* pixels) const { stbi_image_free(pixels); }
};

using Pixels = std::unique_ptr<stbi_uc, FreePixels>;

/// Why a picture whose size cannot be told cannot be read. Only the attempt to read all of it says
/// whether that is so for its size.
const char* whyUnknown(std::span<const std::uint8_t> bytes) {
    int unused = 0;
    const Pixels pixels(stbi_load_from_memory(bytes.data(), static_cast<int>(bytes.size()), &unused,
                                              &unused, &unused, 4));
    const char* const reason = stbi_failure_reason();
    const bool is_too_large = reason != nullptr && std::string_view(reason) == "too large";
    return pixels == nullptr && is_too_large
               ? too_large
               : "it is not a picture of a known kind (PNG, JPEG, BMP, TGA, GIF)";
}

} // namespace

Result<Texture> decodeTexture(std::span<const std::uint8_t> bytes, ReadingBudget& budget) {
    if (bytes.size() > most_bytes) {
        return Error{"it is larger than 256 MB"};
    }
    const int size = static_cast<int>(bytes.size());
    int width = 0;
    int height = 0;
    int channels = 0;
    if (stbi_info_from_memory(bytes.data(), size, &width, &height, &channels) == 0) {
        return Error{whyUnknown(bytes)};
    }
    if (static_cast<std::int64_t>(width) * height > most_pixels) {
        return Error{too_large};
    }
    const std::size_t byte_count = 4 * static_cast<std::size_t>(width) * height;
    if (const Result<void> taken = budget.take(byte_count, "textures"); !taken) {
        return taken.error();
    }
    const Pixels pixels(stbi_load_from_memory(bytes.data(), size, &width, &height, &channels, 4));
    if (pixels == nullptr) {
        budget.giveBack(byte_count);
        return Error{"the picture is damaged"};
    }
    Texture texture;
    texture.width = width;
    texture.height = height;
    texture.rgba.assign(pixels.get(), pixels.get() + byte_count);
    return texture;
}

Result<Texture> readTextureFile(const std::filesystem::path& path, ReadingBudget& budget) {
    const Result<FileBytes> file = readFileBytes(path, most_bytes);
    if (!file) {
        return file.error();
    }
    return decodeTexture(file.value().bytes(), budget);
}

} // namespace quarn
