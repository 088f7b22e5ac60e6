#include "engine/images/JpegFormat.h"

#include <turbojpeg.h>

namespace quarn {
namespace {

constexpr int quality = 90;
constexpr int longest_side = 65500;

} // namespace

JpegEncoder::~JpegEncoder() {
    tjFree(m_buffer);
    if (m_compressor != nullptr) {
        tjDestroy(m_compressor);
    }
}

bool JpegEncoder::makeRoom(const ImageView& image) {
    const unsigned long needed = tjBufSize(image.width, image.height, TJSAMP_444);
    if (needed > m_capacity) {
        tjFree(m_buffer);
        m_buffer = tjAlloc(static_cast<int>(needed));
        m_capacity = m_buffer == nullptr ? 0 : needed;
    }
    return m_buffer != nullptr;
}

Result<std::span<const std::byte>> JpegEncoder::encode(const ImageView& image) {
    if (image.width > longest_side || image.height > longest_side) {
        return Error{"a JPEG picture has at most 65500 pixels a side"};
    }
    constexpr std::uint64_t most_pixels = 500'000'000; // the buffer's size is an int
    if (static_cast<std::uint64_t>(image.width) * static_cast<std::uint64_t>(image.height) >
        most_pixels) {
        return Error{"the picture is too large"};
    }
    if (m_compressor == nullptr) {
        m_compressor = tjInitCompress();
    }
    if (m_compressor == nullptr || !makeRoom(image)) {
        return Error{"there is not enough memory"};
    }
    unsigned long size = m_capacity;
    if (tjCompress2(m_compressor, image.rgba.data(), image.width, 0, image.height, TJPF_RGBX,
                    &m_buffer, &size, TJSAMP_444, quality, TJFLAG_NOREALLOC) != 0) {
        return Error{tjGetErrorStr2(m_compressor)};
    }
    return std::span<const std::byte>(reinterpret_cast<const std::byte*>(m_buffer), size);
}

} // namespace quarn
