#include "quarn/runs/Recording.h"

#include "quarn/runs/OutputFolder.h"
#include "quarn/session/Interruption.h"

#include <cstdio>

namespace quarn::program {

namespace {

using Clock = std::chrono::steady_clock;

std::string frameCountText(int frames) {
    return std::to_string(frames) + (frames == 1 ? " frame" : " frames");
}

/// What became of the recording, once the command that records has ended.
class RecordingEnd {
public:
    RecordingEnd(const RecordingRequest& request, ConsoleFrontEnd& front_end)
        : m_request(request), m_written(front_end.framesWritten()),
          m_reason(front_end.lastWords()) {}

    Outcome outcome(bool command_succeeded, Clock::duration taken) const {
        const bool is_complete = m_written == m_request.frames;
        if (!is_complete && isInterruptionRequested())
            return stopped(interruptedText(command_succeeded));
        if (!is_complete)
            return Outcome::failure(incompleteText());
        if (!command_succeeded)
            return Outcome::failure("all frames were written, but the page " + page() +
                                    " could not be" + reasonText() + ".");
        const double seconds = std::chrono::duration<double>(taken).count();
        return Outcome::success(frameCountText(m_written) + " and " + page() + " in " +
                                timeText(seconds));
    }

private:
    std::string page() const { return pagePath(m_request).native(); }
    std::string reasonText() const { return m_reason.empty() ? "" : ": " + m_reason; }

    std::string countText() const {
        return std::to_string(m_written) + " of " + frameCountText(m_request.frames);
    }

    std::string interruptedText(bool is_page_there) const {
        const std::string text = "Stopped after " + countText();
        return text + (is_page_there ? "; " + page() + " plays what is there."
                                     : "; the page " + page() + " could not be written.");
    }

    std::string incompleteText() const {
        return "only " + countText() + " were written to " + m_request.folder.native() +
               (m_reason.empty() ? ". Is there space left?" : reasonText());
    }

    const RecordingRequest& m_request;
    int m_written;
    std::string m_reason;
};

Outcome record(const RecordingRequest& request, const RecordingScript& script, HostSession& host,
               Clock::time_point start) {
    if (const auto refusal = whyFolderCannotBeUsed(request.folder))
        return Outcome::failure(*refusal);
    if (script.saving)
        if (const auto trouble = host.run(*script.saving))
            return *trouble;
    if (isInterruptionRequested())
        return stopped("Stopped before anything was recorded.");
    ConsoleFrontEnd& front_end = host.frontEnd();
    front_end.beginRecording(request.frames);
    const auto trouble = host.run(script.recording);
    front_end.clearProgress();
    return RecordingEnd(request, front_end).outcome(!trouble, Clock::now() - start);
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
    tellNotes(script);
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common);
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
