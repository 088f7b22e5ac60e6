#pragma once

#include "host/share/film/FilmModule.h"

namespace quarn {

/// What is to be known of a kind of film before one is made.
struct FilmKindFacts {
    FilmKind kind;
    const char* extension;    ///< with its dot
    int usual_width_px;       ///< at most, where nobody says otherwise; 0: as wide as the frames
    int most_frames_a_second; ///< that its players show
    bool has_even_sides;
    bool has_quality;            ///< else nothing is lost
    bool is_slow;                ///< to encode
    const char* encoder_package; ///< of Debian
};

/// The kind that the extension of a file stands for, ignoring case; null for every other.
const FilmKindFacts* filmKindOf(const std::filesystem::path& file);

struct FilmSize {
    int width_px = 0;
    int height_px = 0;
};

/// The size of a film of frames of this size: scaled in proportion, never larger than they are but
/// by the pixels that make the sides even.
/// @param asked_width_px  0: as usual for the kind
FilmSize filmSize(const FilmKindFacts& kind, FilmSize frames, int asked_width_px);

} // namespace quarn
