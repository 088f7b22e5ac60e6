#include "quarn/runs/FinishRun.h"

#include "host/session/RecordingProgress.h"
#include "quarn/runs/DocumentRecording.h"
#include "quarn/runs/FolderInstructions.h"
#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

namespace quarn::program {

namespace {

/// @param recorded  the folder, or a file in it
std::filesystem::path folderOf(const std::filesystem::path& recorded) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(recorded, error))
        return recorded;
    return recorded.has_parent_path() ? recorded.parent_path() : std::filesystem::path(".");
}

/// @return why the document of the recording cannot be opened; nothing where it may
std::optional<std::string> whyNoDocument(const std::filesystem::path& folder,
                                         const RecordingProgress& progress) {
    const std::filesystem::path& document = progress.document;
    if (!isDocument(document))
        return folder.native() + " does not say which saved document it was recorded from: name "
                                 "one with --document, or run the command that began the recording "
                                 "once more, which goes on where it stopped.";
    if (const auto refusal = whyPathIsRefused(
            "the path of the document that " + folder.native() + " names", document))
        return *refusal;
    std::error_code error;
    if (!std::filesystem::exists(document, error))
        return document.native() + ", which " + folder.native() +
               " was recorded from, is not there: say with --document where it is.";
    return std::nullopt;
}

} // namespace

Outcome finishRecording(const FinishRequest& request, const ScriptUse& use) {
    const auto start = std::chrono::steady_clock::now();
    watchForInterruption();
    DocumentRecordingRequest all;
    all.folder = folderOf(request.recorded);
    all.document = request.document;
    if (use.common.overwrites)
        all.start = RecordingStartKind::if_same;
    all.quality = request.quality ? request.quality : jpegQualityOf(request.recorded);
    all.film = request.film;
    all.viewer = request.viewer;
    const RecordingProgressResult found = recordingProgress(request.recorded);
    if (!found.trouble.empty() && (all.document.empty() || !use.is_only_shown))
        return Outcome::failure(found.trouble);
    if (all.document.empty()) {
        if (const auto trouble = whyNoDocument(all.folder, found.progress))
            return Outcome::failure(*trouble);
        all.document = found.progress.document;
    }
    if (use.is_only_shown)
        return Outcome::success(scriptText(composeDocumentRecording(all, all.folder)));
    CommonOptions common = use.common;
    if (const auto refusal = takeInstructionsOf(request.recorded, common))
        return *refusal;
    return recordHere(all, {.retries = request.retries, .names_missing = true}, common, start);
}

} // namespace quarn::program
