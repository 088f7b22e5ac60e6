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

/// With its dot; empty for a name without one, and for one that begins with its only dot.
std::string_view extensionOf(std::string_view path) {
    const std::string_view name = path.substr(path.rfind('/') + 1);
    const std::size_t dot = name.rfind('.');
    const bool has_extension = dot != std::string_view::npos && dot > 0 && name != "..";
    return has_extension ? name.substr(dot) : std::string_view();
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

struct ImageEncoder::Buffers {
    JpegEncoder jpeg;
    PngEncoder png;
    std::vector<std::byte> bytes;
};

ImageEncoder::ImageEncoder() : m_buffers(std::make_unique<Buffers>()) {}
ImageEncoder::~ImageEncoder() = default;
ImageEncoder::ImageEncoder(ImageEncoder&&) noexcept = default;
ImageEncoder& ImageEncoder::operator=(ImageEncoder&&) noexcept = default;

Result<std::span<const std::byte>> ImageEncoder::encode(const ImageView& image,
                                                        ImageFormat format) {
    if (const std::string why = whyNotEncodable(image); !why.empty()) {
        return Error{why};
    }
    if (format == ImageFormat::jpeg) {
        return m_buffers->jpeg.encode(image);
    }
    std::vector<std::byte>& bytes = m_buffers->bytes;
    bytes.clear();
    const Result<void> encoded = format == ImageFormat::png   ? m_buffers->png.encode(image, bytes)
                                 : format == ImageFormat::bmp ? encodeBmp(image, bytes)
                                                              : encodeTga(image, bytes);
    if (!encoded) {
        return encoded.error();
    }
    return std::span<const std::byte>(bytes);
}

Result<void> ImageEncoder::write(const char* path, const ImageView& image) {
    const std::string_view extension = extensionOf(path);
    const auto format = imageFormatFor(extension);
    if (!format) {
        return Error{"Cannot write '" + std::string(path) + "': pictures of the kind '" +
                     std::string(extension) + "' are not known. Choose jpg, png, bmp or tga."};
    }
    const auto encoded = encode(image, *format);
    if (!encoded) {
        return Error{"Cannot write '" + std::string(path) + "': " + encoded.message() + "."};
    }
    return writeFileAtomically(path, encoded.value());
}

Result<void> writeImageFile(const std::filesystem::path& path, const ImageView& image) {
    return ImageEncoder().write(path.c_str(), image);
}

} // namespace quarn
