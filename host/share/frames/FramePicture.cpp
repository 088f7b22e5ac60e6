#include "host/share/frames/FramePicture.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "import/textures/TextureDecoding.h"

#include <cstdint>
#include <limits>
#include <span>

namespace quarn {

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::size_t MOST_BYTES = 256U << 20;

bool beginsAsJpeg(Bytes bytes) {
    return bytes.size() > 2 && bytes[0] == 0xFF && bytes[1] == 0xD8;
}

/// Of a picture that is cut the decoder would make a grey rest.
bool isCutJpeg(Bytes bytes) {
    return beginsAsJpeg(bytes) &&
           (bytes[bytes.size() - 2] != 0xFF || bytes[bytes.size() - 1] != 0xD9);
}

Result<Image> decoded(Bytes bytes) {
    if (bytes.empty())
        return Error{"the file is empty"};
    if (isCutJpeg(bytes))
        return Error{"the picture is cut off"};
    // What a picture may take is bounded by its pixels.
    ReadingBudget budget(std::numeric_limits<std::uint64_t>::max());
    Result<Texture> texture = decodeTexture(bytes, budget);
    if (!texture)
        return texture.error();
    Image image;
    image.width = texture.value().width;
    image.height = texture.value().height;
    image.rgba = std::move(texture.value().rgba);
    return image;
}

} // namespace

Result<Image> readFramePicture(const std::filesystem::path& file) {
    const auto refused = [&](const std::string& why) {
        return Error{"Cannot read the frame " + textFromPath(file).ToUtf8() + ": " + why + '.'};
    };
    const Result<FileBytes> bytes = readFileBytes(file, MOST_BYTES);
    if (!bytes)
        return refused(bytes.message());
    Result<Image> image = decoded(bytes.value().bytes());
    return image ? std::move(image) : refused(image.message());
}

} // namespace quarn
