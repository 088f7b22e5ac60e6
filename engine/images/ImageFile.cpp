#include "engine/images/ImageFile.h"

#include "engine/images/JpegFormat.h"
#include "engine/images/PlainFormats.h"
#include "engine/images/PngFormat.h"
#include "ground/AtomicFile.h"

#include <algorithm>
#include <array>
#include <utility>

namespace quarn {
namespace {

std::string whyNotEncodable(const ImageView& image) {
    if (image.width <= 0 || image.height <= 0) {
        return "the picture is empty";
    }
    const std::uint64_t pixels =
        static_cast<std::uint64_t>(image.width) * static_cast<std::uint64_t>(image.height);
    return image.rgba.size() == 4 * pixels ? std::string()
                                           : "the picture's pixels do not fit its size";
}

Result<void> appendFile(const ImageView& image, ImageFormat format, int jpeg_quality,
                        std::vector<std::byte>& bytes) {
    switch (format) {
    case ImageFormat::jpeg:
        return encodeJpeg(image, jpeg_quality, bytes);
    case ImageFormat::png:
        return encodePng(image, bytes);
    case ImageFormat::bmp:
        return encodeBmp(image, bytes);
    default:
        return encodeTga(image, bytes);
    }
}

} // namespace

std::optional<ImageFormat> imageFormatFor(std::string_view extension) {
    std::string name(extension.substr(extension.starts_with('.') ? 1 : 0));
    for (char& c : name) {
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
    }
    static constexpr std::array<std::pair<std::string_view, ImageFormat>, 5> formats{
        {{"jpg", ImageFormat::jpeg},
         {"jpeg", ImageFormat::jpeg},
         {"png", ImageFormat::png},
         {"bmp", ImageFormat::bmp},
         {"tga", ImageFormat::tga}}};
    const auto found = std::find_if(formats.begin(), formats.end(),
                                    [&name](const auto& format) { return format.first == name; });
    return found == formats.end() ? std::nullopt : std::optional(found->second);
}

Result<std::vector<std::byte>> encodeImage(const ImageView& image, ImageFormat format,
                                           int jpeg_quality) {
    if (std::string why = whyNotEncodable(image); !why.empty()) {
        return Error{std::move(why)};
    }
    std::vector<std::byte> bytes;
    if (const Result<void> encoded = appendFile(image, format, jpeg_quality, bytes); !encoded) {
        return encoded.error();
    }
    return bytes;
}

Result<void> writeImageFile(const std::filesystem::path& path, const ImageView& image,
                            Protection protection, int jpeg_quality) {
    const auto format = imageFormatFor(path.extension().string());
    if (!format) {
        return Error{"Cannot write '" + path.string() + "': pictures of the kind '" +
                     path.extension().string() + "' are not known. Choose jpg, png, bmp or tga."};
    }
    const auto encoded = encodeImage(image, *format, jpeg_quality);
    if (!encoded) {
        return Error{"Cannot write '" + path.string() + "': " + encoded.message() + "."};
    }
    return writeFileAtomically(path, encoded.value(), protection);
}

} // namespace quarn
