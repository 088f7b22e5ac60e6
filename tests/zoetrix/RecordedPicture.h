#pragma once

#include <cstdint>
#include <filesystem>
#include <vector>

/// A picture file as it was written, in grey.
struct RecordedPicture {
    int width_px = 0;
    int height_px = 0;
    std::vector<std::uint8_t> bytes; ///< one a pixel, the top row first

    double at(int x, int y) const {
        return bytes[static_cast<std::size_t>(y) * static_cast<std::size_t>(width_px) +
                     static_cast<std::size_t>(x)];
    }
};

/// Reads a PNG file with a reader that the host does not write with; an empty picture for anything
/// else.
RecordedPicture readPng(const std::filesystem::path& file);
