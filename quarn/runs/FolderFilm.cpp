#include "quarn/runs/FolderFilm.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome makeFolderFilm(const FolderFilmRequest& request, const ScriptUse& use) {
    const std::string line = folderFilmLine(request.film, request.folder);
    if (use.is_only_shown)
        return Outcome::success(line);
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(use.common));
    HostSession host(front_end, use.common);
    const auto trouble = host.run(line);
    front_end.clearProgress();
    if (front_end.sharedFiles().empty())
        return trouble.value_or(Outcome::success(""));
    const std::string text = front_end.lastSharedText();
    if (isInterruptionRequested())
        return stopped("Stopped; the film has the frames until then.\n" + text);
    return Outcome::success(front_end.hidesWords() ? text : "");
}

} // namespace quarn::program
