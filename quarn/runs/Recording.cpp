#include "quarn/runs/Recording.h"

#include "host/session/FilmCheck.h"
#include "host/session/RecordingCheck.h"
#include "quarn/runs/OutputFolder.h"
#include "quarn/session/Interruption.h"

#include <algorithm>
#include <cstdio>

namespace quarn::program {

namespace {

using Clock = std::chrono::steady_clock;

/// What became of the recording, once the command that records has ended.
class RecordingEnd {
public:
    RecordingEnd(const RecordingRequest& request, const ConsoleFrontEnd& front_end)
        : m_request(request), m_end(endOf(request, front_end)), m_shared(front_end.sharedFiles()) {}

    Outcome outcome(Clock::duration taken) const {
        const bool is_complete = m_end.report.isComplete();
        if (!is_complete && isInterruptionRequested())
            return stopped(interruptedText(m_end.report) + sharedText(m_shared));
        if (!is_complete)
            return Outcome::failure(incompleteText(m_end) + sharedText(m_shared));
        if (!m_end.report.has_page)
            return Outcome::failure("all frames were written, but the page " + page() +
                                    " could not be" + reasonText() + ".");
        const double seconds = std::chrono::duration<double>(taken).count();
        if (std::ranges::any_of(m_shared, [](const auto& file) { return !file.is_made; }))
            return Outcome::failure("all frames and the page were written, but not all that was to "
                                    "be made of them." +
                                    sharedText(m_shared));
        const std::string left_over = leftOverText(m_end.report);
        return Outcome::success(frameCountText(m_end.report.there) + " and " + page() + " in " +
                                timeText(seconds) + (left_over.empty() ? "" : "\n" + left_over) +
                                sharedText(m_shared));
    }

private:
    /// A recording that never began in its folder tells why in its last words alone.
    static EndedRecording endOf(const RecordingRequest& request, const ConsoleFrontEnd& front_end) {
        if (!front_end.recordings().empty())
            return front_end.recordings().back();
        RecordingReport report;
        report.folder = request.folder;
        report.page = pagePath(request);
        report.expected = request.frames;
        return {report, front_end.lastWords()};
    }

    std::string page() const { return pagePath(m_request).native(); }
    std::string reasonText() const {
        return m_end.last_words.empty() ? "" : ": " + m_end.last_words;
    }

    const RecordingRequest& m_request;
    EndedRecording m_end;
    const std::vector<SharedFileReport>& m_shared;
};

/// What cannot come to its end is not begun: reading the model may take long.
std::optional<Outcome> refuse(const RecordingRequest& request, bool overwrites) {
    if (const auto refusal = whyTooManyFrames(request.frames))
        return Outcome::failure(*refusal);
    if (request.has_own_folder && !isFolderForRecordings(request.folder))
        return Outcome::failure(request.folder.native() +
                                " is there already, and nothing was recorded into it; choose the "
                                "folder for the pictures with --out.");
    const RecordingTarget target{request.folder, request.name, request.format, request.frames,
                                 overwrites};
    if (const auto refusal = whyRecordingIsRefused(target))
        return Outcome::failure(*refusal);
    const FilmRequest& film = request.film;
    if (film.file.empty())
        return std::nullopt;
    if (const auto refusal = whyFilmIsRefused({film.file, film.frame_rate, film.quality,
                                               film.has_caption, overwrites, request.folder}))
        return Outcome::failure(*refusal);
    return std::nullopt;
}

/// Makes of the frames what is asked for; what became of it is told behind the recording.
Outcome share(const RecordingScript& script, HostSession& host, const Outcome& recorded) {
    std::string text = recorded.text;
    for (const std::string& line : script.sharing) {
        const auto trouble = host.run(line);
        host.frontEnd().clearProgress();
        if (trouble && isInterruptionRequested())
            return stopped(text + "\nStopped before the viewer page was written.");
        if (trouble)
            return {trouble->exit_code, text + "\n" + trouble->text};
        if (host.frontEnd().hidesWords())
            text += "\n" + host.frontEnd().lastSharedText();
    }
    return Outcome::success(text);
}

Outcome record(const RecordingRequest& request, const RecordingScript& script, HostSession& host,
               Clock::time_point start) {
    if (const auto refusal = whyFolderCannotBeUsed(request.folder))
        return Outcome::failure(*refusal);
    if (script.saving)
        if (const auto trouble = host.run(*script.saving))
            return *trouble;
    for (const std::string& line : script.following)
        if (const auto trouble = host.run(line))
            return *trouble;
    if (isInterruptionRequested())
        return stopped("Stopped before anything was recorded.");
    ConsoleFrontEnd& front_end = host.frontEnd();
    front_end.beginRecording(request.frames);
    (void)host.run(script.recording); // what counts is what there is
    front_end.clearProgress();
    const Outcome end = RecordingEnd(request, front_end).outcome(Clock::now() - start);
    return end.exit_code == Outcome::done ? share(script, host, end) : end;
}

/// At once, so that they can be read while the recording runs.
void tellNotes(const RecordingScript& script) {
    for (const std::string& note : script.notes)
        std::puts(note.c_str());
    std::fflush(stdout);
}

Outcome runRecording(const RecordingRequest& request, const RecordingScript& script,
                     const CommonOptions& common) {
    const Clock::time_point start = Clock::now();
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common);
    if (const auto refusal = refuse(request, common.overwrites))
        return *refusal;
    tellNotes(script);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(script.reading, request.model))
        return *trouble;
    for (const std::string& line : script.set_up)
        if (const auto trouble = host.run(line))
            return *trouble;
    return record(request, script, host, start);
}

} // namespace

Outcome recordOrShow(const RecordingRequest& request, const AnimationLines& lines,
                     const ScriptUse& use) {
    const RecordingScript script = composeRecording(request, lines);
    if (use.is_only_shown)
        return Outcome::success(scriptText(script));
    return runRecording(request, script, use.common);
}

} // namespace quarn::program
