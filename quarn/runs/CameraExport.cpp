#include "quarn/runs/CameraExport.h"

#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

std::string exportLine(const CameraExportRequest& request) {
    const std::string rate =
        request.frame_rate ? "[FrameRate] " + std::to_string(*request.frame_rate) + " " : "";
    return "_-ExportCamera " + rate + quotedPath(request.file);
}

/// The host's words tell what was written, and what a person should know of it.
Outcome runExport(const std::string& line, HostSession& host) {
    ConsoleFrontEnd& front_end = host.frontEnd();
    front_end.keepWords();
    const auto trouble = host.run(line);
    std::string words = front_end.takeKeptWords();
    if (trouble && isInterruptionRequested())
        return stopped("Stopped before anything was written.");
    if (trouble)
        return *trouble;
    if (front_end.hidesWords())
        words += front_end.lastSharedText();
    words.resize(words.find_last_not_of('\n') + 1);
    return Outcome::success(words);
}

} // namespace

Outcome exportCamera(const CameraExportRequest& request, const ScriptUse& use) {
    const std::string reading = readingLine(request.document);
    const std::string exporting = exportLine(request);
    if (use.is_only_shown)
        return Outcome::success(reading + "\n" + exporting + "\n");
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(use.common));
    HostSession host(front_end, use.common);
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(reading, request.document))
        return *trouble;
    return runExport(exporting, host);
}

} // namespace quarn::program
