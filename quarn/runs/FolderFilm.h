#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/scripts/FilmScript.h"

namespace quarn::program {

/// A film that is to be made of what was recorded before.
struct FolderFilmRequest {
    std::filesystem::path folder;
    FilmRequest film;
};

/// `quarn video`: composes the command that makes a film of recorded frames, and runs it or returns
/// it.
Outcome makeFolderFilm(const FolderFilmRequest& request, const ScriptUse& use);

} // namespace quarn::program
