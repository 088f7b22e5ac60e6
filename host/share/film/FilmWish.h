#pragma once

#include "host/share/film/FilmKinds.h"

namespace quarn {

/// The film that a person wants.
struct FilmWish {
    std::filesystem::path file;
    int frame_rate = 0;       ///< frames a second; 0: as its length asks for
    int quality = 0;          ///< 1 to 100; 0: as usual
    int width_px = 0;         ///< 0: as usual for its kind
    bool has_caption = false; ///< the date and time of each frame of a sun study
    bool may_replace = false; ///< a file that is there
};

constexpr int USUAL_FILM_QUALITY = 80;

/// Looks at all that can be known before there is a frame: the kind of film and what it can do, its
/// place, its encoder.
/// @param folder_to_come  a folder that will be made before the film is; may be empty
/// @return why the film cannot be made, in a sentence of the user's language that says what to do
Result<void> checkFilm(const FilmWish& wish, const Result<const FilmModule*>& module,
                       const std::filesystem::path& folder_to_come = {});

/// Opens the module that makes films, once.
/// @return an error, a part of a sentence, where it is not there
const Result<const FilmModule*>& filmModule();

} // namespace quarn
