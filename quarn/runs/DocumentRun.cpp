#include "quarn/runs/DocumentRun.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome runOnDocument(const std::filesystem::path& document, const std::string& line,
                      const ScriptUse& use, const std::function<Outcome(HostSession&)>& done) {
    const std::string reading = readingLine(document);
    if (use.is_only_shown)
        return Outcome::success(reading + "\n" + line + "\n");
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(use.common));
    HostSession host(front_end, use.common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(reading, document))
        return *trouble;
    return done(host);
}

} // namespace quarn::program
