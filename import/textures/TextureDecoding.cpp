#include "import/textures/TextureDecoding.h"

#include "ground/FileBytes.h"
#include "import/textures/AvifPicture.h"
#include "import/textures/PlainPicture.h"
#include "import/textures/PngPicture.h"
#include "import/textures/WebpPicture.h"

#include <algorithm>
#include <string_view>

namespace quarn {

namespace {

constexpr std::int64_t MOST_PIXELS = 64LL << 20;
constexpr std::int64_t MOST_IN_A_ROW = 16384;
constexpr std::uintmax_t MOST_BYTES = 256ULL << 20;

using Bytes = std::span<const std::uint8_t>;

const PictureFormat* formatOf(Bytes file) {
    for (const PictureFormat* const format :
         {&PNG_PICTURES, &WEBP_PICTURES, &AVIF_PICTURES, &PLAIN_PICTURES})
        if (format->begins(file))
            return format;
    return nullptr;
}

/// Pictures that people have for a reason, so that they are told what it is.
std::string whyUnknown(Bytes file) {
    const std::string_view head(reinterpret_cast<const char*>(file.data()),
                                std::min<std::size_t>(file.size(), 12));
    constexpr std::string_view KNOWN =
        "those that are read are PNG, JPEG, WebP, AVIF, BMP, TGA and GIF";
    std::string kind = "it is not a picture of a known kind";
    if (head.substr(0, 7) == "\xABKTX 20" || head.substr(0, 7) == "\xABKTX 11")
        kind = "it is a KTX picture";
    else if (head.ends_with("ftypavif") || head.ends_with("ftypavis"))
        kind = "it is an AVIF picture, for which libavif is not installed";
    return kind + "; " + std::string(KNOWN);
}

bool isTooLarge(const PictureSize& size) {
    return std::max(size.width, size.height) > MOST_IN_A_ROW ||
           size.width * size.height > MOST_PIXELS;
}

} // namespace

Result<Texture> decodeTexture(Bytes bytes, ReadingBudget& budget) {
    if (bytes.size() > MOST_BYTES)
        return Error{"it is larger than 256 MB"};
    const PictureFormat* const format = formatOf(bytes);
    if (format == nullptr)
        return Error{whyUnknown(bytes)};
    const std::optional<PictureSize> size = format->size(bytes);
    if (!size || size->width < 1 || size->height < 1)
        return Error{"the picture is damaged"};
    if (isTooLarge(*size))
        return Error{"it is too large: more than 64 million pixels, or more than 16384 in a row"};
    if (const Result<void> taken = budget.take(size->bytes(), "textures"); !taken)
        return taken.error();
    Texture texture;
    texture.width = static_cast<int>(size->width);
    texture.height = static_cast<int>(size->height);
    texture.rgba.resize(size->bytes());
    if (format->decode(bytes, texture.rgba))
        return texture;
    budget.giveBack(size->bytes());
    return Error{"the picture is damaged"};
}

Result<Texture> readTextureFile(const std::filesystem::path& path, ReadingBudget& budget) {
    const Result<FileBytes> file = readFileBytes(path, MOST_BYTES);
    if (!file)
        return file.error();
    return decodeTexture(file.value().bytes(), budget);
}

} // namespace quarn
