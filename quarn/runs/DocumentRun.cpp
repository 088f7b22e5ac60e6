#include "quarn/runs/DocumentRun.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome runOnDocument(const std::filesystem::path& document, const std::vector<std::string>& lines,
                      const ScriptUse& use, const std::function<Outcome(HostSession&)>& done) {
    const std::string reading = readingLine(document);
    if (use.is_only_shown) {
        std::string text = reading + "\n";
        for (const std::string& line : lines)
            text += line + "\n";
        return Outcome::success(text);
    }
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
