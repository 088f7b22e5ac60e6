#pragma once

#include "host/share/film/FilmMaking.h"

namespace quarn {

/// Makes a film of the frames of a folder, in the order of their numbers. What is odd about the
/// folder is told. A person who asks the program to stop gets a film of the frames until then.
/// @param wish  checked
/// @return what the film holds; an error, in a sentence of the user's language: there is no
///         recording in the folder, a frame cannot be read, frames are of several sizes or tell no
///         time where that is wanted, the film cannot be written
Result<SharedFileReport> makeFilmOfFolder(const std::filesystem::path& folder, const FilmWish& wish,
                                          FrontEnd& front_end);

} // namespace quarn
