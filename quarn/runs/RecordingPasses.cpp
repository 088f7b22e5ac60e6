#include "quarn/runs/RecordingPasses.h"

#include "quarn/runs/OtherRecorders.h"
#include "quarn/session/Interruption.h"

#include <algorithm>

namespace quarn::program {

namespace {

/// What was there when the first pass began is kept; all that came since then is written, whoever
/// wrote it.
void addPass(const EndedRecording& pass, std::optional<int> kept_before,
             std::optional<EndedRecording>& all) {
    const int kept = all ? all->report.kept : kept_before.value_or(pass.report.kept);
    all = pass;
    RecordingReport& report = all->report;
    report.written = std::max(0, report.written + report.kept - kept);
    report.kept = kept;
}

/// @return why the host refused to record; nothing where it did, or tried to
std::optional<std::string> runPass(const RecordingRun& run, const std::string& beginning,
                                   HostSession& host) {
    ConsoleFrontEnd& front_end = host.frontEnd();
    const std::size_t ended = front_end.recordings().size();
    front_end.beginRecording(run.frames);
    if (!host.run(beginning))
        (void)host.run(run.script.recording); // what counts is what there is
    front_end.clearProgress();
    if (front_end.recordings().size() == ended)
        return front_end.closingWords();
    if (!front_end.hasRecordingBegun())
        return front_end.recordings().back().last_words;
    return std::nullopt;
}

} // namespace

PassesEnd runPasses(const RecordingRun& run, HostSession& host) {
    ConsoleFrontEnd& front_end = host.frontEnd();
    OtherRecorders others(recordingFile(run), run.part, front_end);
    std::string beginning = run.script.beginning;
    PassesEnd end;
    for (int retries = run.retries;;) {
        const auto start = std::chrono::steady_clock::now();
        if (const auto refusal = runPass(run, beginning, host)) {
            end.reason = *refusal;
            return end;
        }
        addPass(front_end.recordings().back(), run.kept_before, end.recording);
        beginning = beginningLine(RecordingStartKind::resume, run.part.text());
        const RecordingReport& report = end.recording->report;
        if (report.isComplete() || isInterruptionRequested())
            return end;
        if (report.elsewhere == 0 && retries-- <= 0)
            return end;
        if (report.elsewhere > 0 && !run.waits_for_others)
            return end;
        if (report.elsewhere > 0 && !others.wait(std::chrono::steady_clock::now() - start)) {
            end.reason = others.reason();
            return end;
        }
    }
}

} // namespace quarn::program
