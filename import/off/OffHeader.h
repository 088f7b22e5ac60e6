#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <string_view>

namespace quarn {

/// What the head of an OFF file states.
struct OffHeader {
    bool has_textures = false; ///< vertices have texture coordinates
    bool has_colors = false;   ///< vertices have colours
    bool has_normals = false;
    bool has_weights = false; ///< a fourth coordinate divides the others
    std::uint64_t vertices = 0;
    std::uint64_t faces = 0;
    std::string_view body; ///< the lines behind it
};

/// Whether a line of an OFF file holds more than blanks and a comment.
bool isFilledOffLine(std::string_view line);

/// Reads the head of an OFF file: a keyword, which may be missing, and three counts.
/// @return an error, a part of a sentence, where it is damaged, of a kind that is not read, or
///   claims more than the file can hold
Result<OffHeader> readOffHeader(std::string_view text, char line_break);

} // namespace quarn
