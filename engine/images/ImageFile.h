#pragma once

#include "engine/images/Image.h"
#include "ground/AtomicFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

namespace quarn {

enum class ImageFormat { jpeg, png, bmp, tga };

/// Whether pictures of a format may be see-through.
constexpr bool holdsOpacity(ImageFormat format) {
    return format == ImageFormat::png || format == ImageFormat::tga;
}

/// The format that an extension stands for, ignoring case: jpg, jpeg, png, bmp, tga. The extension
/// may have its dot. Nothing for any other.
std::optional<ImageFormat> imageFormatFor(std::string_view extension);

/// The pixels of a picture, which someone else keeps.
struct ImageView {
    int width = 0;                      ///< pixels
    int height = 0;                     ///< pixels
    std::span<const std::uint8_t> rgba; ///< 4 * width * height bytes, sRGB, rows from the top

    ImageView() = default;
    ImageView(int width_px, int height_px, std::span<const std::uint8_t> pixels)
        : width(width_px), height(height_px), rgba(pixels) {}
    ImageView(const Image& image) : ImageView(image.width, image.height, image.rgba) {}
};

/// The quality of JPEG pictures, from 1 to 100, where nobody chooses another one.
inline constexpr int STANDARD_JPEG_QUALITY = 90;

/// Turns a picture into the bytes of an image file, with 24 bits a pixel; PNG and TGA of a picture
/// that is see-through somewhere with 32, the last 8 its opacity, which JPEG and BMP leave out.
/// JPEG has full colour resolution. BMP and TGA are not compressed.
/// @param jpeg_quality  1 to 100; of no account to the other formats
/// @return why the picture cannot be encoded, a part of a sentence: it is empty, its size and its
///   pixels disagree, or a side is longer than the format allows (65500 for JPEG, 65535 for TGA)
Result<std::vector<std::byte>> encodeImage(const ImageView& image, ImageFormat format,
                                           int jpeg_quality = STANDARD_JPEG_QUALITY);

/// Encodes and writes a picture in the format of the path's extension. The file appears whole or
/// not at all, and replaces one of the same name.
/// @param protection    whether a file that is protected from writing is left alone
/// @param jpeg_quality  as encodeImage has it
/// @return an error that names the file: unknown extension, the picture cannot be encoded, the
///   folder is missing, no permission, write-protected, the disk is full
Result<void> writeImageFile(const std::filesystem::path& path, const ImageView& image,
                            Protection protection = Protection::respected,
                            int jpeg_quality = STANDARD_JPEG_QUALITY);

} // namespace quarn
