#pragma once

#include "host/share/film/FilmModule.h"

#include <string>
#include <utility>
#include <vector>

extern "C" {
#include <libavutil/pixfmt.h>
}

namespace quarn {

/// How the libraries make a kind of film.
struct FilmRecipe {
    const char* encoder;
    const char* container;
    AVPixelFormat pixels;   ///< that the encoder takes
    AVPixelFormat prepared; ///< that pictures are scaled and captioned in
    bool has_video_colours; ///< luma and colour difference by BT.709, in its limited range
    bool is_one_packet;     ///< all frames come out of the encoder together, at the end
};

const FilmRecipe& recipeOf(FilmKind kind);

using AvOptions = std::vector<std::pair<std::string, std::string>>;

AvOptions encoderOptions(const FilmForm& form);
AvOptions containerOptions(const FilmForm& form);

/// Colours of the one palette of a film.
int paletteColours(const FilmForm& form);

} // namespace quarn
