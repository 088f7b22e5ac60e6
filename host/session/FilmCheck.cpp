#include "host/session/FilmCheck.h"

#include "host/share/film/FilmWish.h"

namespace quarn {

std::optional<std::string> whyFilmIsRefused(const FilmTarget& target) {
    FilmWish wish;
    wish.file = target.file;
    wish.frame_rate = target.frame_rate;
    wish.quality = target.quality;
    wish.has_caption = target.has_caption;
    wish.may_replace = target.overwrites;
    const auto checked = checkFilm(wish, filmModule(), target.recording_folder);
    return checked ? std::nullopt : std::optional(checked.message());
}

} // namespace quarn
