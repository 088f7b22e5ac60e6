#include "quarn/runs/PageRun.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome writePage(const std::filesystem::path& recorded, const ViewerRequest& request,
                  const ScriptUse& use) {
    const std::string line = viewerLine(recorded, request);
    if (use.is_only_shown)
        return Outcome::success(line + "\n");
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(use.common));
    HostSession host(front_end, use.common);
    const auto trouble = host.run(line);
    front_end.clearProgress();
    if (trouble && isInterruptionRequested())
        return stopped("Stopped before the page was written.");
    if (trouble)
        return *trouble;
    return Outcome::success(front_end.hidesWords() ? front_end.lastSharedText() : "");
}

} // namespace quarn::program
