#include "import/textures/PngPicture.h"

#include <spng.h>

#include <algorithm>
#include <array>
#include <memory>

namespace quarn {

namespace {

using Bytes = std::span<const std::uint8_t>;

/// Texts and colour profiles, which are stepped over, may be compressed bombs.
constexpr std::size_t MOST_CHUNK = 1U << 20;

struct FreeContext {
    void operator()(spng_ctx* context) const { spng_ctx_free(context); }
};

using Context = std::unique_ptr<spng_ctx, FreeContext>;

/// Null where the file is damaged. Wrong check sums alone are no reason to leave a picture out.
Context contextOf(Bytes file) {
    Context context(spng_ctx_new(0));
    if (context == nullptr || spng_set_crc_action(context.get(), SPNG_CRC_USE, SPNG_CRC_USE) != 0 ||
        spng_set_chunk_limits(context.get(), MOST_CHUNK, 4 * MOST_CHUNK) != 0 ||
        spng_set_png_buffer(context.get(), file.data(), file.size()) != 0)
        return nullptr;
    return context;
}

bool isPng(Bytes file) {
    constexpr std::array<std::uint8_t, 8> MARK{0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    return file.size() >= MARK.size() && std::equal(MARK.begin(), MARK.end(), file.begin());
}

/// A number of four bytes, highest first.
std::int64_t numberAt(Bytes file, std::size_t at) {
    std::int64_t number = 0;
    for (const std::uint8_t byte : file.subspan(at, 4))
        number = number * 256 + byte;
    return number;
}

/// From the first chunk, which has its place by the format (ISO/IEC 15948, 11.2.2): the library
/// says nothing of pictures that are too large for it.
std::optional<PictureSize> sizeOfPng(Bytes file) {
    constexpr std::size_t WIDTH = 16;
    constexpr std::size_t HEIGHT = 20;
    if (file.size() < HEIGHT + 4)
        return std::nullopt;
    return PictureSize{numberAt(file, WIDTH), numberAt(file, HEIGHT)};
}

bool decodePng(Bytes file, std::span<std::uint8_t> rgba) {
    const Context context = contextOf(file);
    return context != nullptr && spng_decode_image(context.get(), rgba.data(), rgba.size(),
                                                   SPNG_FMT_RGBA8, SPNG_DECODE_TRNS) == 0;
}

} // namespace

const PictureFormat PNG_PICTURES{isPng, sizeOfPng, decodePng};

} // namespace quarn
