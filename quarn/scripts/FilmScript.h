#pragma once

#include <filesystem>
#include <string>

namespace quarn::program {

/// A film that is made of a recording.
struct FilmRequest {
    std::filesystem::path file; ///< empty: none is wanted
    int frame_rate = 0;         ///< frames a second; 0: by the number of frames
    int quality = 0;            ///< 1 to 100; 0: as usual
    int width_px = 0;           ///< 0: as usual for its kind
    bool has_caption = false;   ///< the date and time of each frame
};

/// The host command that makes a film of the recording that follows it.
std::string nextFilmLine(const FilmRequest& film);
/// The host command that makes a film of the frames in a folder.
std::string folderFilmLine(const FilmRequest& film, const std::filesystem::path& folder);

} // namespace quarn::program
