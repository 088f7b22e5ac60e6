#include "host/recovery/RecoverableDocuments.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/app/DocumentSaving.h"
#include "host/document/DocumentList.h"
#include "host/recovery/RecoveryCoding.h"
#include "host/recovery/RecoveryGlance.h"
#include "host/recovery/RecoveryMarks.h"

#include <algorithm>
#include <ctime>
#include <optional>
#include <sys/stat.h>
#include <system_error>

namespace quarn {

namespace {

namespace fs = std::filesystem;

/// Where the folder is not there, it may be on a disk that is not in the machine just now.
bool isGone(const fs::path& recovery) {
    std::error_code error;
    const bool exists = fs::exists(recovery, error);
    return !exists && !error && fs::is_directory(recovery.parent_path(), error);
}

std::optional<RecoverableDocument> recoverableAt(const fs::path& mark_file) {
    const auto mark = readMark(mark_file);
    if (!mark || !hasEnded(mark->writer))
        return std::nullopt;
    std::error_code error;
    if (isGone(mark->recovery))
        removeRecovery(mark_file);
    if (!fs::is_regular_file(mark->recovery, error))
        return std::nullopt;
    RecoveryGlance glance = glanceAt(mark->recovery);
    return RecoverableDocument{.recovery = mark->recovery,
                               .mark = mark_file,
                               .document = mark->document,
                               .name = textFromPath(mark->document.stem()),
                               .kept_at = glance.kept_at,
                               .picture = std::move(glance.picture)};
}

std::string localTime(std::chrono::system_clock::time_point time) {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
    std::tm local{};
    char text[32] = "";
    if (localtime_r(&seconds, &local))
        std::strftime(text, sizeof text, "%Y-%m-%d %H:%M", &local);
    return text;
}

bool wasChangedSince(const fs::path& file, std::chrono::system_clock::time_point time) {
    using namespace std::chrono;
    struct stat status {};
    if (file.empty() || stat(file.c_str(), &status) != 0)
        return false;
    const auto since_epoch = seconds(status.st_mtim.tv_sec) + nanoseconds(status.st_mtim.tv_nsec);
    return system_clock::time_point(duration_cast<system_clock::duration>(since_epoch)) > time;
}

Error cannotRecover(const RecoverableDocument& document, const std::string& why) {
    return {"Cannot recover from " + textFromPath(document.recovery).ToUtf8() + ": " + why + "."};
}

std::vector<std::string> tidingsOf(const RecoverableDocument& document,
                                   const RecoveredState& state) {
    std::vector<std::string> lines = {"Recovered " + textOf(document) + "."};
    if (state.lost_its_end)
        lines.push_back("The last of what was kept is not whole; this is the document as it was "
                        "at " +
                        localTime(state.kept_at) + ".");
    if (wasChangedSince(document.document, state.kept_at))
        lines.push_back(textFromPath(document.document.filename()).ToUtf8() +
                        " was changed after this was kept. Save would replace it; SaveAs keeps "
                        "both.");
    return lines;
}

} // namespace

std::vector<RecoverableDocument> recoverableIn(const fs::path& state_folder) {
    std::vector<RecoverableDocument> documents;
    if (state_folder.empty())
        return documents;
    for (const fs::path& mark : marksIn(recoveryFolder(state_folder)))
        if (auto document = recoverableAt(mark))
            documents.push_back(std::move(*document));
    std::ranges::sort(documents, std::ranges::greater(), &RecoverableDocument::kept_at);
    return documents;
}

bool hasNewerFile(const RecoverableDocument& document) {
    return wasChangedSince(document.document, document.kept_at);
}

std::string textOf(const RecoverableDocument& document) {
    const std::string kept = "kept " + localTime(document.kept_at);
    if (document.document.empty())
        return "a document without a name, " + kept;
    return "\"" + document.name.ToUtf8() + "\", " + kept + ", of " +
           textFromPath(document.document).ToUtf8();
}

Result<std::vector<std::string>> openRecovered(DocumentList& list,
                                               const RecoverableDocument& recoverable) {
    const auto bytes = readFileBytes(recoverable.recovery);
    if (!bytes)
        return cannotRecover(recoverable, bytes.message());
    const auto state = decodeRecovery(bytes.value().bytes());
    if (!state)
        return cannotRecover(recoverable, state.message());
    std::vector<std::string> told = tidingsOf(recoverable, state.value());
    Document& document = list.openNew();
    const auto warnings = openContent(document, state.value().content);
    told.insert(told.end(), warnings.begin(), warnings.end());
    document.setFile(recoverable.document);
    document.setRecoveredFrom(recoverable.mark);
    document.markUnsaved();
    return told;
}

} // namespace quarn
