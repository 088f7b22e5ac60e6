#include "quarn/runs/CameraExport.h"

#include "quarn/runs/DocumentRun.h"
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
    const std::string line = exportLine(request);
    return runOnDocument(request.document, {line}, use,
                         [&](HostSession& host) { return runExport(line, host); });
}

} // namespace quarn::program
