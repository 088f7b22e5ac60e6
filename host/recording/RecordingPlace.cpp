#include "host/recording/RecordingPlace.h"

#include "ground/PartFile.h"
#include "ground/PathText.h"
#include "host/recording/FrameNames.h"
#include "host/recording/FramesManifest.h"
#include "host/recording/RecordedPage.h"
#include "host/recording/RecordingJournal.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <vector>

namespace quarn {

namespace {

namespace fs = std::filesystem;

/// A recording that did not come to its end may have written any picture that it meant to: none of
/// them was there when it began.
OwnFiles filesOf(const RecordingFile& recording) {
    OwnFiles own{recording.owns_page, recording.earlier};
    FrameSet& frames = own.pictures[recording.settings.extension];
    frames.add(recording.written);
    if (recording.is_running)
        frames.add(FrameSet::firstOf(recording.settings.frames));
    return own;
}

OwnFiles filesOfPage(const RecordingPlace& place) {
    const auto pictures = picturesOfPage(place.page(), place.animation);
    return pictures ? OwnFiles{true, *pictures} : OwnFiles{};
}

/// Whether nothing is lost when a recording replaces the list of frames: there is none, or one of
/// frames of this name.
bool mayReplaceManifest(const RecordingPlace& place) {
    const fs::path file = place.folder / manifestName(place.animation);
    std::error_code error;
    if (!fs::exists(fs::symlink_status(file, error)))
        return true;
    const auto manifest = readFramesManifest(file);
    return manifest && manifest.value().name == place.animation;
}

/// The names of files that the recording would replace though they are not its own. A folder of
/// such a name cannot be replaced and is told where it is in the way.
std::vector<std::string> filesInTheWay(const RecordingPlace& place, const OwnFiles& own) {
    const FrameNames names{place.animation, place.extension};
    const std::string page = pageName(place.animation);
    std::vector<std::string> found;
    std::error_code error;
    for (fs::directory_iterator at(place.folder, error), end; !error && at != end;
         at.increment(error)) {
        const std::string name = at->path().filename().native();
        const auto frame = names.frameOf(name);
        const bool is_wanted = frame ? *frame < place.frames : name == page;
        const bool is_own = frame ? own.owns(place.extension, *frame) : own.owns_page;
        std::error_code unknown;
        if (is_wanted && !is_own && !at->is_directory(unknown))
            found.push_back(name);
    }
    if (!mayReplaceManifest(place))
        found.push_back(manifestName(place.animation));
    return found;
}

Error inTheWay(const RecordingPlace& place, const std::vector<std::string>& names) {
    const KM_wString first =
        textFromPath(place.folder / *std::min_element(names.begin(), names.end()));
    const KM_wString animation = KM_wString::FromUtf8(place.animation);
    if (names.size() == 1)
        return {KM_wString::FormatToString(
                    QnLocalizeString(L"%s is not replaced: no recording named %s wrote it. Record "
                                     L"into another folder or under another name, or start the "
                                     L"program with --overwrite.",
                                     42530),
                    first.Array(), animation.Array())
                    .ToUtf8()};
    return {KM_wString::FormatToString(
                QnLocalizeString(L"%s and %d more files beside it are not replaced: no recording "
                                 L"named %s wrote them. Record into another folder or under "
                                 L"another name, or start the program with --overwrite.",
                                 42531),
                first.Array(), static_cast<int>(names.size() - 1), animation.Array())
                .ToUtf8()};
}

} // namespace

Error isRecorded(const RecordingPlace& place, const ProcessIdentity& writer) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"%s is being recorded into %s by process %d on %s. Wait until "
                                 L"that recording has ended, or choose another folder or another "
                                 L"name.",
                                 42532),
                KM_wString::FromUtf8(place.animation).Array(), textFromPath(place.folder).Array(),
                writer.pid, KM_wString::FromUtf8(writer.host).Array())
                .ToUtf8()};
}

fs::file_time_type timeOfDisk(const fs::path& folder) {
    const PartFile probe(folder, 0600);
    std::error_code error;
    const auto now = fs::last_write_time(probe.path(), error);
    return error ? fs::file_time_type::clock::now() : now;
}

std::optional<ProcessIdentity> whoRecords(const RecordingPlace& place, const fs::path& own_journal,
                                          std::chrono::seconds lease) {
    std::optional<fs::file_time_type> now;
    for (const fs::path& file : journalsIn(place.folder, place.animation)) {
        if (file == own_journal)
            continue;
        if (!now)
            now = timeOfDisk(place.folder);
        JournalReader journal(file);
        (void)journal.readOn().ok();
        if (journal.content().head.animation == place.animation &&
            isWriterAlive(journal, *now, lease))
            return journal.content().head.writer;
    }
    return std::nullopt;
}

fs::path RecordingPlace::recordingFile() const {
    return folder / recordingFileName(animation);
}

fs::path RecordingPlace::page() const {
    return folder / pageName(animation);
}

bool OwnFiles::owns(const std::string& extension, int frame) const {
    const auto frames = pictures.find(extension);
    return frames != pictures.end() && frames->second.has(frame);
}

Result<OwnFiles> checkRecordingPlace(const RecordingPlace& place, bool overwrites) {
    const auto read = readRecordingFile(place.recordingFile());
    if (!read && !overwrites)
        return read.error();
    const bool is_known = read && read.value();
    OwnFiles own = is_known ? filesOf(*read.value()) : filesOfPage(place);
    if (overwrites)
        return own;
    if (const auto names = filesInTheWay(place, own); !names.empty())
        return inTheWay(place, names);
    return own;
}

} // namespace quarn
