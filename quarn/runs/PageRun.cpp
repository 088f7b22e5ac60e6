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
    if (const auto trouble = host.run(line))
        return *trouble;
    return Outcome::success(use.common.is_verbose ? "" : front_end.lastWords());
}

} // namespace quarn::program
