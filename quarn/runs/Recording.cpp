#include "quarn/runs/Recording.h"

#include "host/session/FilmCheck.h"
#include "host/session/RecordingCheck.h"
#include "quarn/runs/RecordingRun.h"
#include "quarn/session/Interruption.h"

#include <cstdio>

namespace quarn::program {

namespace {

/// What cannot come to its end is not begun: reading the model may take long.
std::optional<Outcome> refuse(const RecordingRequest& request, bool overwrites) {
    if (const auto refusal = whyTooManyFrames(request.frames))
        return Outcome::failure(*refusal);
    if (request.has_own_folder && !isFolderForRecordings(request.folder))
        return Outcome::failure(request.folder.native() +
                                " is there already, and nothing was recorded into it; choose the "
                                "folder for the pictures with --out.");
    constexpr bool MAY_GO_ON = true; // with frames that another one makes of the same recording
    const RecordingTarget target{request.folder, request.name, request.format,
                                 request.frames, overwrites,   MAY_GO_ON};
    if (const auto refusal = whyRecordingIsRefused(target))
        return Outcome::failure(*refusal);
    return refuseFilm(request.film, request.folder, overwrites);
}

/// At once, so that they can be read while the recording runs.
void tellNotes(const RecordingScript& script) {
    for (const std::string& note : script.notes)
        std::puts(note.c_str());
    std::fflush(stdout);
}

Outcome setUpAndRecord(const RecordingRequest& request, const RecordingScript& script,
                       const CommonOptions& common) {
    const auto start = std::chrono::steady_clock::now();
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
    return runRecording({.script = script,
                         .folder = request.folder,
                         .page = pagePath(request),
                         .frames = request.frames},
                        host, start);
}

} // namespace

std::optional<Outcome> refuseFilm(const FilmRequest& film, const std::filesystem::path& folder,
                                  bool overwrites) {
    if (film.file.empty())
        return std::nullopt;
    if (const auto refusal = whyFilmIsRefused(
            {film.file, film.frame_rate, film.quality, film.has_caption, overwrites, folder}))
        return Outcome::failure(*refusal);
    return std::nullopt;
}

Outcome recordOrShow(const RecordingRequest& request, const AnimationLines& lines,
                     const ScriptUse& use) {
    RecordingRequest settled = request;
    settled.goes_on = request.goes_on && !use.common.overwrites;
    const RecordingScript script = composeRecording(settled, lines);
    if (use.is_only_shown)
        return Outcome::success(scriptText(script));
    return setUpAndRecord(settled, script, use.common);
}

} // namespace quarn::program
