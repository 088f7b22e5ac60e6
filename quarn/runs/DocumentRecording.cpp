#include "quarn/runs/DocumentRecording.h"

#include "host/session/AnimationState.h"
#include "quarn/runs/FolderInstructions.h"
#include "quarn/runs/RecorderJobs.h"
#include "quarn/runs/RecordingRun.h"
#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

/// The same frames by their numbers: pages are for those who ask for all.
FrameRanges asPart(const FrameRanges& wanted, int frames) {
    return wanted.areAll() ? FrameRanges({{0, frames - 1, 1}}) : wanted;
}

Outcome withoutAnimation(const std::filesystem::path& document) {
    return Outcome::failure(document.native() +
                            " has no animation that can be recorded; quarn turntable and the like "
                            "keep a document that has one with --save.");
}

Outcome recordAnimation(DocumentRecordingRequest request, const FrameCare& care,
                        const AnimationState& animation, HostSession& host,
                        std::chrono::steady_clock::time_point start) {
    const std::string name = animation.name.ToUtf8();
    if (care.is_recorder)
        request.part = asPart(request.part, animation.frame_count);
    const RecordingScript script =
        composeDocumentRecording(request, request.folder / (name + ".frames.json"));
    for (const std::string& line : script.set_up)
        if (const auto trouble = host.run(line))
            return *trouble;
    return runRecording({.script = script,
                         .folder = request.folder,
                         .page = request.folder / (name + ".html"),
                         .frames = animation.frame_count,
                         .part = request.part,
                         .retries = care.retries,
                         .names_missing = care.names_missing,
                         .waits_for_others = !care.is_recorder,
                         .kept_before = care.kept_before},
                        host, start);
}

} // namespace

Outcome recordHere(const DocumentRecordingRequest& request, const FrameCare& care,
                   const CommonOptions& common, std::chrono::steady_clock::time_point start) {
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common);
    if (const auto refusal = refuseFilm(request.film, request.folder, common.overwrites))
        return *refusal;
    if (const auto trouble = host.loadAnimationPlugIn())
        return *trouble;
    if (const auto trouble = host.runReading(readingLine(request.document), request.document))
        return *trouble;
    const AnimationState animation = animationState(host.session().document());
    if (!animation.can_play)
        return withoutAnimation(request.document);
    return recordAnimation(request, care, animation, host, start);
}

Outcome recordDocument(const DocumentRecordingRequest& request, int jobs, const ScriptUse& use) {
    if (use.is_only_shown)
        return Outcome::success(scriptText(composeDocumentRecording(request, request.folder)));
    const auto start = std::chrono::steady_clock::now();
    watchForInterruption();
    CommonOptions common = use.common;
    DocumentRecordingRequest settled = request;
    if (request.start != RecordingStartKind::anew) {
        if (const auto refusal = takeInstructionsOf(request.folder, common))
            return *refusal;
        if (!settled.quality)
            settled.quality = jpegQualityOf(request.folder);
    }
    if (jobs > 1)
        return recordWithJobs(settled, jobs, common, start);
    return recordHere(settled, {.names_missing = true}, common, start);
}

Outcome runRecorder(const DocumentRecordingRequest& request, const CommonOptions& common) {
    watchForInterruption();
    return recordHere(request, {.is_recorder = true}, common, std::chrono::steady_clock::now());
}

} // namespace quarn::program
