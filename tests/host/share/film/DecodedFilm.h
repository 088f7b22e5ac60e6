#pragma once

#include "engine/images/Image.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn::test {

/// A film as a player sees it.
struct DecodedFilm {
    std::vector<Image> frames;
    double seconds = 0.0;           ///< until the end of the last frame
    std::string encoding;           ///< "h264"; empty for WebP
    std::string pixels;             ///< "yuv420p"
    bool has_video_colours = false; ///< marked as BT.709 in its limited range
    std::string trouble;            ///< why it could not be read; empty where it could
};

/// Decodes a film with the libraries that players use.
DecodedFilm decodeFilm(const std::filesystem::path& file);

/// The peak signal-to-noise ratio of two pictures of one size, over red, green and blue, in
/// decibels; 0 where their sizes differ, 99 where they are the same.
double psnr(const Image& one, const Image& other);

} // namespace quarn::test
