#include "quarn/runs/ScriptRun.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

namespace {

int framesWritten(const ConsoleFrontEnd& front_end) {
    int frames = 0;
    for (const EndedRecording& recording : front_end.recordings())
        frames += recording.report.written;
    return frames;
}

/// The command that records succeeds wherever it came to its page; what counts is what there is.
/// @param trouble  what ended the script; nothing where it came to its end
Outcome outcomeOf(const std::optional<std::string>& trouble, const ConsoleFrontEnd& front_end) {
    std::string told = trouble.value_or("");
    for (const EndedRecording& recording : front_end.recordings())
        if (!recording.report.isComplete())
            told += (told.empty() ? "" : "\nquarn: ") + incompleteText(recording);
    for (const SharedFileReport& file : front_end.sharedFiles())
        if (!file.is_made)
            told += (told.empty() ? "" : "\nquarn: ") + file.text.ToUtf8();
    return told.empty() ? Outcome::success("") : Outcome::failure(told);
}

} // namespace

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
        return stopped("Stopped; " + frameCountText(framesWritten(front_end)) + " were written.");
    return outcomeOf(trouble, front_end);
}

} // namespace quarn::program
