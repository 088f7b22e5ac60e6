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
Context contextOf(Bytes file, spng_ihdr& head) {
    Context context(spng_ctx_new(0));
    if (context == nullptr || spng_set_crc_action(context.get(), SPNG_CRC_USE, SPNG_CRC_USE) != 0 ||
        spng_set_chunk_limits(context.get(), MOST_CHUNK, 4 * MOST_CHUNK) != 0 ||
        spng_set_png_buffer(context.get(), file.data(), file.size()) != 0 ||
        spng_get_ihdr(context.get(), &head) != 0)
        return nullptr;
    return context;
}

bool isPng(Bytes file) {
    constexpr std::array<std::uint8_t, 8> MARK{0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    return file.size() >= MARK.size() && std::equal(MARK.begin(), MARK.end(), file.begin());
}

std::optional<PictureSize> sizeOfPng(Bytes file) {
    spng_ihdr head{};
    if (contextOf(file, head) == nullptr)
        return std::nullopt;
    return PictureSize{head.width, head.height};
}

bool decodePng(Bytes file, std::span<std::uint8_t> rgba) {
    spng_ihdr head{};
    const Context context = contextOf(file, head);
    return context != nullptr && spng_decode_image(context.get(), rgba.data(), rgba.size(),
                                                   SPNG_FMT_RGBA8, SPNG_DECODE_TRNS) == 0;
}

} // namespace

const PictureFormat PNG_PICTURES{isPng, sizeOfPng, decodePng};

} // namespace quarn
