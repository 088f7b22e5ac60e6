#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// A film that a program is about to have made of a recording.
struct FilmTarget {
    std::filesystem::path file;
    int frame_rate = 0;       ///< frames a second; 0: as usual
    int quality = 0;          ///< 1 to 100; 0: as usual
    bool has_caption = false; ///< the date and time of each frame
    bool overwrites = false;  ///< as SessionOptions has it
    /// That will be made before the film is.
    std::filesystem::path recording_folder;
};

/// Looks at the film as the command Film will once more, before what takes time is begun.
/// @return why it cannot be made, in a sentence of the user's language that says what to do;
///         nothing when it can
QNCORE_API std::optional<std::string> whyFilmIsRefused(const FilmTarget& target);

} // namespace quarn
