#include "engine/images/JpegFormat.h"

#include <memory>
#include <turbojpeg.h>

namespace quarn {
namespace {

constexpr int longest_side = 65500;
constexpr std::uint64_t most_pixels = 500'000'000; // the buffer's size is an int

struct DestroyCompressor {
    void operator()(void* compressor) const { tjDestroy(compressor); }
};
struct FreeBuffer {
    void operator()(unsigned char* buffer) const { tjFree(buffer); }
};

} // namespace

Result<void> encodeJpeg(const ImageView& image, int quality, std::vector<std::byte>& bytes) {
    if (image.width > longest_side || image.height > longest_side) {
        return Error{"a JPEG picture has at most 65500 pixels a side"};
    }
    if (static_cast<std::uint64_t>(image.width) * static_cast<std::uint64_t>(image.height) >
        most_pixels) {
        return Error{"the picture is too large"};
    }
    unsigned long size = tjBufSize(image.width, image.height, TJSAMP_444);
    const std::unique_ptr<void, DestroyCompressor> compressor(tjInitCompress());
    const std::unique_ptr<unsigned char, FreeBuffer> buffer(tjAlloc(static_cast<int>(size)));
    if (!compressor || !buffer) {
        return Error{"there is not enough memory"};
    }
    unsigned char* target = buffer.get();
    if (tjCompress2(compressor.get(), image.rgba.data(), image.width, 0, image.height, TJPF_RGBX,
                    &target, &size, TJSAMP_444, quality, TJFLAG_NOREALLOC) != 0) {
        return Error{tjGetErrorStr2(compressor.get())};
    }
    const auto* const begin = reinterpret_cast<const std::byte*>(target);
    bytes.insert(bytes.end(), begin, begin + size);
    return {};
}

} // namespace quarn
