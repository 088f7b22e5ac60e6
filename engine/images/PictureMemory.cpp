#include "engine/images/PictureMemory.h"

#include "ground/FreeMemory.h"

#include <string>

namespace quarn {

namespace {

constexpr std::uint64_t bytes_per_pixel = 18; ///< 4 each, and 6 for the file at worst
constexpr std::int64_t small_px = 16LL << 20; ///< not worth asking the system

std::int64_t pixelsOf(int width_px, int height_px) {
    return std::int64_t{width_px} * height_px;
}

} // namespace

std::uint64_t pictureBytes(int width_px, int height_px) {
    return bytes_per_pixel * static_cast<std::uint64_t>(pixelsOf(width_px, height_px));
}

Result<void> checkPictureMemory(int width_px, int height_px, std::int64_t held_px) {
    const std::int64_t pixels = pixelsOf(width_px, height_px);
    if (pixels <= small_px || pixels <= held_px)
        return {};
    return checkPictureMemory(width_px, height_px, held_px, freeMemory());
}

Result<void> checkPictureMemory(int width_px, int height_px, std::int64_t held_px,
                                std::uint64_t free_bytes) {
    const std::uint64_t needed = pictureBytes(width_px, height_px);
    const bool is_held = pixelsOf(width_px, height_px) <= held_px;
    if (is_held || needed <= free_bytes)
        return {};
    return Error{"A picture of " + std::to_string(width_px) + " by " + std::to_string(height_px) +
                 " pixels cannot be drawn: there is too little memory. It needs " +
                 gigabyteText(needed) + ", and " + gigabyteText(free_bytes) +
                 " are free. Close other programs, or choose a smaller size."};
}

} // namespace quarn
