#include "quarn/runs/ScriptRun.h"

#include "quarn/session/HostSession.h"
#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome runScript(const ScriptOptions& options) {
    watchForInterruption();
    ConsoleFrontEnd front_end(ConsoleFrontEnd::Prints::shown);
    HostSession host(front_end, options.common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (!options.model.empty())
        if (const auto trouble = host.readModel(options.model))
            return *trouble;
    front_end.beginRecording(0);
    const bool is_done = host.session().runScriptFile(options.script);
    front_end.clearProgress();
    if (isInterruptionRequested())
        return stopped("Stopped; " + std::to_string(front_end.framesWritten()) +
                       " frames were written.");
    if (is_done)
        return Outcome::success("");
    const std::string words = front_end.lastWords();
    return Outcome::failure(words.empty() ? options.script + " was not run to its end." : words);
}

} // namespace quarn::program
