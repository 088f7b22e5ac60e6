#include "host/session/RecordingProgress.h"

#include "ground/PathText.h"
#include "host/recording/FrameNames.h"
#include "host/recording/KnownFrames.h"
#include "host/recording/RecordingPlace.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <numeric>
#include <set>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view RECORDING_END = ".recording";

std::string sentence(const wchar_t* text, const fs::path& folder) {
    return KM_wString::FormatToString(text, textFromPath(folder).Array()).ToUtf8();
}

/// The recordings of a folder, or the one that a file names.
std::vector<fs::path> recordingFilesIn(const fs::path& folder) {
    std::error_code error;
    if (fs::is_regular_file(folder, error))
        return {folder};
    std::vector<fs::path> files;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error))
        if (at->path().extension() == RECORDING_END)
            files.push_back(at->path());
    return files;
}

std::set<std::string> namesIn(const fs::path& folder) {
    std::set<std::string> names;
    std::error_code error;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error))
        names.insert(at->path().filename().native());
    return names;
}

RecordingWriter writerOf(const JournalReader& journal, fs::file_time_type now) {
    const RecordingJournal& content = journal.content();
    RecordingWriter writer;
    writer.host = content.head.writer.host;
    writer.pid = content.head.writer.pid;
    writer.frames = static_cast<int>(content.frames.size());
    writer.seconds =
        std::accumulate(content.frames.begin(), content.frames.end(), 0.0,
                        [](double sum, const JournalFrame& frame) { return sum + frame.seconds; });
    writer.loading_seconds = content.head.loading_seconds;
    writer.is_alive = isWriterAlive(journal, now, JOURNAL_LEASE);
    writer.trouble = content.trouble;
    return writer;
}

RecordingProgress settingsOf(const RecordingFile& file) {
    RecordingProgress progress;
    progress.name = file.animation;
    progress.document = file.document;
    progress.frames = file.settings.frames;
    progress.jpeg_quality = file.settings.jpeg_quality;
    progress.instructions = file.fingerprint.instructions;
    progress.document_mark = file.fingerprint.document;
    progress.settings_mark = file.fingerprint.settings;
    return progress;
}

/// Looks at all who record.
void addFramesAndWriters(const fs::path& folder, const RecordingFile& file,
                         RecordingProgress& progress) {
    KnownFrames known({folder, file.animation}, file.fingerprint);
    known.refresh();
    const std::set<std::string> names = namesIn(folder);
    for (int number = 0; number < progress.frames; ++number) {
        const ManifestFrame* const frame = known.find(number);
        if (!frame || !names.contains(frame->file))
            progress.missing.push_back(number);
    }
    const auto now = timeOfDisk(folder);
    for (const JournalReader& journal : known.journals())
        if (journal.content().head.animation == file.animation)
            progress.writers.push_back(writerOf(journal, now));
    progress.has_page = names.contains(pageName(file.animation));
    progress.is_finished = progress.missing.empty() && !file.is_running &&
                           names.contains(manifestName(file.animation));
}

/// The recording of a folder, or the one that a file names.
Result<RecordingFile> recordingOf(const fs::path& folder) {
    const std::vector<fs::path> files = recordingFilesIn(folder);
    if (files.size() > 1)
        return Error{sentence(QnLocalizeString(L"%s holds several recordings. Name the file "
                                               L"NAME.recording of one of them.",
                                               42870),
                              folder)};
    const auto read =
        files.empty() ? Result(std::optional<RecordingFile>()) : readRecordingFile(files.front());
    if (!read)
        return read.error();
    if (!read.value())
        return Error{sentence(QnLocalizeString(L"%s holds no recording.", 42869), folder)};
    return *read.value();
}

fs::path folderOf(const fs::path& folder_or_file) {
    std::error_code error;
    if (!fs::is_regular_file(folder_or_file, error))
        return folder_or_file;
    return folder_or_file.has_parent_path() ? folder_or_file.parent_path() : ".";
}

} // namespace

RecordingProgressResult recordingSettings(const fs::path& folder) {
    const auto file = recordingOf(folder);
    if (!file)
        return {{}, file.message()};
    return {settingsOf(file.value()), {}};
}

RecordingProgressResult recordingProgress(const fs::path& folder) {
    const auto file = recordingOf(folder);
    if (!file)
        return {{}, file.message()};
    RecordingProgress progress = settingsOf(file.value());
    addFramesAndWriters(folderOf(folder), file.value(), progress);
    return {std::move(progress), {}};
}

} // namespace quarn
