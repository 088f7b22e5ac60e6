#include "quarn/scripts/FilmScript.h"

#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

std::string numberAnswer(const char* option, int number) {
    return number > 0 ? std::string(option) + " " + std::to_string(number) + " " : "";
}

std::string filmLine(const FilmRequest& film, const std::string& source) {
    return "_-Film " + numberAnswer("_FrameRate", film.frame_rate) +
           numberAnswer("_Quality", film.quality) + numberAnswer("_Width", film.width_px) +
           (film.has_caption ? "_Caption=Yes " : "") + source + " " + quotedPath(film.file);
}

} // namespace

std::string nextFilmLine(const FilmRequest& film) {
    return filmLine(film, "_NextRecording");
}

std::string folderFilmLine(const FilmRequest& film, const std::filesystem::path& folder) {
    return filmLine(film, quotedPath(folder));
}

} // namespace quarn::program
