#pragma once

#include <cstdint>
#include <optional>
#include <span>

namespace quarn {

/// In pixels.
struct PictureSize {
    std::int64_t width = 0;
    std::int64_t height = 0;

    /// Of its pixels in memory.
    std::uint64_t bytes() const { return 4 * static_cast<std::uint64_t>(width * height); }
};

/// What reads pictures of one format.
struct PictureFormat {
    /// True for the first bytes of such a file.
    bool (*begins)(std::span<const std::uint8_t> file);
    /// What the file's head says, at no cost; nothing where it is damaged.
    std::optional<PictureSize> (*size)(std::span<const std::uint8_t> file);
    /// Reads all pixels: red, green, blue and opacity, rows from the top.
    /// @param rgba  of that size; no more is written, whatever the file holds
    /// @return false where the file is damaged
    bool (*decode)(std::span<const std::uint8_t> file, std::span<std::uint8_t> rgba);
};

} // namespace quarn
