#include "quarn/runs/ScriptRun.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome runScript(const std::filesystem::path& script, const std::filesystem::path& model,
                  const CommonOptions& common) {
    watchForInterruption();
    ConsoleFrontEnd front_end(ConsoleFrontEnd::Prints::shown);
    HostSession host(front_end, common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (!model.empty())
        if (const auto trouble = host.readModel(model))
            return *trouble;
    front_end.beginRecording(0);
    const std::optional<std::string> trouble = host.session().runScriptFile(script);
    front_end.clearProgress();
    if (isInterruptionRequested())
        return stopped("Stopped; " + std::to_string(front_end.framesWritten()) +
                       " frames were written.");
    return trouble ? Outcome::failure(*trouble) : Outcome::success("");
}

} // namespace quarn::program
