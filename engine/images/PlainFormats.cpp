#include "engine/images/PlainFormats.h"

#include "engine/images/Opacity.h"

#include <cstdint>

namespace quarn {
namespace {

/// Appends little-endian numbers to a file.
class LittleEndianWriter {
public:
    explicit LittleEndianWriter(std::vector<std::byte>& bytes) : m_bytes(bytes) {}

    void put8(std::uint32_t value) { m_bytes.push_back(static_cast<std::byte>(value)); }
    void put16(std::uint32_t value) {
        put8(value);
        put8(value >> 8);
    }
    void put32(std::uint32_t value) {
        put16(value);
        put16(value >> 16);
    }

private:
    std::vector<std::byte>& m_bytes;
};

/// @param pixel_bytes  3, or 4 with the opacity
void appendRowsFromBottom(const ImageView& image, std::size_t pixel_bytes, std::size_t row_bytes,
                          std::vector<std::byte>& bytes) {
    const auto width = static_cast<std::size_t>(image.width);
    const auto height = static_cast<std::size_t>(image.height);
    const std::size_t begin = bytes.size();
    bytes.resize(begin + row_bytes * height, std::byte{0});
    for (std::size_t row = 0; row < height; ++row) {
        const std::uint8_t* pixel = image.rgba.data() + 4 * width * (height - 1 - row);
        std::byte* target = bytes.data() + begin + row_bytes * row;
        for (std::size_t x = 0; x < width; ++x, pixel += 4, target += pixel_bytes) {
            target[0] = static_cast<std::byte>(pixel[2]);
            target[1] = static_cast<std::byte>(pixel[1]);
            target[2] = static_cast<std::byte>(pixel[0]);
            if (pixel_bytes > 3)
                target[3] = static_cast<std::byte>(pixel[3]);
        }
    }
}

} // namespace

Result<void> encodeBmp(const ImageView& image, std::vector<std::byte>& bytes) {
    constexpr std::uint32_t header_bytes = 14 + 40;
    constexpr std::uint32_t pixels_per_metre = 3780; // 96 an inch
    const std::uint64_t row_bytes = (3 * static_cast<std::uint64_t>(image.width) + 3) / 4 * 4;
    const std::uint64_t pixel_bytes = row_bytes * static_cast<std::uint64_t>(image.height);
    if (header_bytes + pixel_bytes > 0xFFFFFFFFU) {
        return Error{"a BMP file has at most 4 GB"};
    }
    LittleEndianWriter out(bytes);
    out.put8('B');
    out.put8('M');
    out.put32(static_cast<std::uint32_t>(header_bytes + pixel_bytes));
    out.put32(0);
    out.put32(header_bytes);
    out.put32(40); // length of the header that follows
    out.put32(static_cast<std::uint32_t>(image.width));
    out.put32(static_cast<std::uint32_t>(image.height)); // positive: rows from the bottom
    out.put16(1);                                        // planes
    out.put16(24);                                       // bits a pixel
    out.put32(0);                                        // not compressed
    out.put32(static_cast<std::uint32_t>(pixel_bytes));
    out.put32(pixels_per_metre);
    out.put32(pixels_per_metre);
    out.put32(0); // no palette
    out.put32(0);
    appendRowsFromBottom(image, 3, row_bytes, bytes);
    return {};
}

Result<void> encodeTga(const ImageView& image, std::vector<std::byte>& bytes) {
    if (image.width > 0xFFFF || image.height > 0xFFFF) {
        return Error{"a TGA picture has at most 65535 pixels a side"};
    }
    const std::uint32_t opacity_bits = isSeeThrough(image) ? 8 : 0;
    LittleEndianWriter out(bytes);
    out.put8(0); // no text before the pixels
    out.put8(0); // no palette
    out.put8(2); // true colour, not compressed
    out.put32(0);
    out.put8(0); // five bytes that describe the palette
    out.put16(0);
    out.put16(0); // origin
    out.put16(static_cast<std::uint32_t>(image.width));
    out.put16(static_cast<std::uint32_t>(image.height));
    out.put8(24 + opacity_bits); // bits a pixel
    out.put8(opacity_bits);      // rows from the bottom
    const std::size_t pixel_bytes = opacity_bits > 0 ? 4 : 3;
    appendRowsFromBottom(image, pixel_bytes, pixel_bytes * static_cast<std::size_t>(image.width),
                         bytes);
    return {};
}

} // namespace quarn
