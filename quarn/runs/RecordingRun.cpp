#include "quarn/runs/RecordingRun.h"

#include "host/session/RecordingProgress.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/runs/RecordingPasses.h"
#include "quarn/session/Interruption.h"

#include <algorithm>

namespace quarn::program {

namespace {

using Clock = std::chrono::steady_clock;

std::string asReason(const std::string& words) {
    return words.empty() ? "" : ": " + words;
}

/// " Frames 3 and 7-9 are missing."
std::string missingText(const RecordingRun& run) {
    if (!run.names_missing)
        return "";
    const std::vector<int> missing =
        run.part.among(recordingProgress(recordingFile(run)).progress.missing);
    if (missing.empty())
        return "";
    return (missing.size() == 1 ? " Frame " : " Frames ") + frameListText(missing) +
           (missing.size() == 1 ? " is missing." : " are missing.");
}

/// A recording that the host refused tells why in its last words alone.
Outcome refused(const RecordingRun& run, const PassesEnd& end) {
    if (isInterruptionRequested())
        return stopped("Stopped before anything was recorded.");
    if (!end.reason.empty())
        return Outcome::failure(end.reason);
    RecordingReport report;
    report.folder = run.folder;
    report.page = run.page;
    report.expected = run.frames;
    return Outcome::failure(incompleteText({report, ""}));
}

/// Frames that are left to others are no failure of a recording that does not wait for them.
bool isDone(const RecordingRun& run, const RecordingReport& report) {
    const int left_to_others = run.waits_for_others ? 0 : report.elsewhere;
    return report.there + left_to_others >= report.expected;
}

/// What became of the recording, once the command that records has ended.
Outcome endOf(const RecordingRun& run, const PassesEnd& end,
              const std::vector<SharedFileReport>& shared, Clock::duration taken) {
    if (!end.recording)
        return refused(run, end);
    const RecordingReport& report = end.recording->report;
    const bool is_done = isDone(run, report);
    if (!is_done && isInterruptionRequested())
        return stopped(stoppedText(report) + sharedText(shared));
    if (!is_done)
        return Outcome::failure(
            incompleteText(*end.recording) +
            (end.reason.empty() ? "" : " It is no longer waited for: " + end.reason + ".") +
            missingText(run) + sharedText(shared));
    if (!report.is_part && !report.has_page)
        return Outcome::failure("all frames were written, but the page " + report.page.native() +
                                " could not be" + asReason(end.recording->last_words) + ".");
    if (std::ranges::any_of(shared, [](const auto& file) { return !file.is_made; }))
        return Outcome::failure("all frames and the page were written, but not all that was to "
                                "be made of them." +
                                sharedText(shared));
    const std::string left_over = leftOverText(report);
    return Outcome::success(doneText(report, std::chrono::duration<double>(taken).count()) +
                            (left_over.empty() ? "" : "\n" + left_over) + sharedText(shared));
}

/// Makes of the frames what is asked for; what became of it is told behind the recording.
Outcome share(const RecordingScript& script, HostSession& host, const Outcome& recorded) {
    std::string text = recorded.text;
    const ConsoleFrontEnd& front_end = host.frontEnd();
    for (const std::string& line : script.sharing) {
        const std::size_t told = front_end.sharedFiles().size();
        const auto trouble = host.run(line);
        host.frontEnd().clearProgress();
        const bool is_told = front_end.sharedFiles().size() > told;
        if (is_told && front_end.hidesWords())
            text += "\n" + front_end.lastSharedText();
        if (isInterruptionRequested())
            return stopped(text + "\nStopped before all was made of the frames.");
        if (trouble)
            return {trouble->exit_code, text + (is_told ? "" : "\n" + trouble->text)};
    }
    return Outcome::success(text);
}

} // namespace

std::filesystem::path recordingFile(const RecordingRun& run) {
    return std::filesystem::path(run.page).replace_extension(".recording");
}

Outcome runRecording(const RecordingRun& run, HostSession& host, Clock::time_point start) {
    if (const auto refusal = whyFolderCannotBeUsed(run.folder))
        return Outcome::failure(*refusal);
    if (run.script.saving)
        if (const auto trouble = host.run(*run.script.saving))
            return *trouble;
    for (const std::string& line : run.script.following)
        if (const auto trouble = host.run(line))
            return *trouble;
    const PassesEnd end = runPasses(run, host);
    const Outcome recorded = endOf(run, end, host.frontEnd().sharedFiles(), Clock::now() - start);
    return recorded.exit_code == Outcome::done ? share(run.script, host, recorded) : recorded;
}

} // namespace quarn::program
