#pragma once

#include "quarn/arguments/OptionAdder.h"
#include "quarn/scripts/FilmScript.h"

namespace quarn::program {

/// Whether the frames of a film may tell dates and times.
enum class FilmTimes { none, perhaps };

/// Adds what a film can be chosen to be like.
void addFilmLook(CLI::App& command, FilmRequest& film, FilmTimes times);
/// The same, and --video, for commands that record.
void addRecordingFilm(CLI::App& command, FilmRequest& film, FilmTimes times);
/// @return why the options of a command that records make no sense together; nothing where they do
std::optional<std::string> whyFilmIsMisused(const FilmRequest& film);

} // namespace quarn::program
