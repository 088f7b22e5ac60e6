#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace quarn::test {

/// What the header of a picture file says.
struct PictureHeader {
    std::string format; ///< "jpg", "png", "bmp" or "tga"
    int width_px;
    int height_px;
};

/// Reads the header, by the rules of the format that the first bytes show.
/// @return nothing for what is no picture
std::optional<PictureHeader> readPictureHeader(const std::filesystem::path& file);

/// A picture of three bytes a pixel.
struct Picture {
    int width_px = 0;
    int height_px = 0;
    std::vector<std::uint8_t> bytes;
};

/// Reads an uncompressed 24-bit bitmap file; an empty picture for anything else.
Picture readBitmap(const std::filesystem::path& file);

/// The mean difference of two pictures of one size, 0 for the same and 1 for black and white.
double meanDifference(const Picture& a, const Picture& b);

/// The names of the files in a folder, sorted.
std::vector<std::string> filesIn(const std::filesystem::path& folder);

} // namespace quarn::test
