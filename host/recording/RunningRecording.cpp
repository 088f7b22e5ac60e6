#include "host/recording/RunningRecording.h"

#include "ground/PathText.h"
#include "host/recording/FolderLock.h"
#include "host/recording/FrameNames.h"
#include "host/recording/FramesManifest.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;

std::string takenOverText(const RecordingFile& other) {
    return KM_wString::FormatToString(
               QnLocalizeString(L"The recording %s ends here: process %d on %s writes it now.",
                                42535),
               KM_wString::FromUtf8(other.animation).Array(), other.writer.pid,
               KM_wString::FromUtf8(other.writer.host).Array())
        .ToUtf8();
}

/// The folder as the parent path of a file in it reads.
fs::path folderAsParent(const fs::path& folder) {
    return (folder / "file").lexically_normal().parent_path();
}

fs::path parentOf(const fs::path& file) {
    return file.lexically_normal().parent_path();
}

} // namespace

RunningRecording::RunningRecording(Plan plan, Tell tell)
    : RunningRecording(std::move(plan), std::move(tell), Pace()) {}

RunningRecording::RunningRecording(Plan plan, Tell tell, Pace pace)
    : m_tell(std::move(tell)), m_pace(pace),
      m_overwrites(plan.overwrites), m_place{{},
                                             plan.animation,
                                             plan.settings.extension,
                                             plan.settings.frames} {
    m_file.animation = std::move(plan.animation);
    m_file.settings = std::move(plan.settings);
    m_file.writer = currentProcess();
    m_file.is_running = true;
    m_file.owns_page = true;
}

bool RunningRecording::begin(const fs::path& folder) {
    if (m_state != State::waiting)
        return m_state == State::running || folderAsParent(folder) != m_parent;
    m_place.folder = folder;
    m_parent = folderAsParent(folder);
    const FolderLock lock(folder);
    const Result<OwnFiles> own = checkRecordingPlace(m_place, m_overwrites);
    if (!own) {
        refuse(own.message());
        return false;
    }
    m_state = State::running;
    m_owned_page = own.value().owns_page;
    m_file.earlier = own.value().pictures;
    std::error_code error;
    fs::remove(folder / manifestName(m_place.animation), error); // it tells of replaced frames
    renew();
    return true;
}

void RunningRecording::refuse(const std::string& why) {
    m_state = State::refused;
    m_tell(why);
}

std::optional<int> RunningRecording::frameOf(const fs::path& file) const {
    return FrameNames{m_place.animation, m_place.extension}.frameOf(file.filename().native());
}

bool RunningRecording::isPage(const fs::path& file) const {
    return file.filename().native() == pageName(m_place.animation);
}

bool RunningRecording::isInPlace(const fs::path& file) const {
    return parentOf(file) == m_parent && (isPage(file) || frameOf(file));
}

bool RunningRecording::mayWrite(const fs::path& file) {
    if (m_state == State::waiting && (isPage(file) || frameOf(file)))
        return begin(file.has_parent_path() ? file.parent_path() : ".");
    return m_state != State::refused || !isInPlace(file);
}

std::optional<int> RunningRecording::fileWritten(const fs::path& file) {
    if (m_state != State::running || !isInPlace(file))
        return std::nullopt;
    if (isPage(file)) {
        m_page_is_written = true;
        return std::nullopt;
    }
    const auto frame = frameOf(file);
    ++m_written;
    m_file.written.add(*frame);
    beat();
    return frame;
}

void RunningRecording::beat() {
    if (m_state != State::running || std::chrono::steady_clock::now() < m_next_beat)
        return;
    const FolderLock lock(m_place.folder);
    if (isStillOurs())
        renew();
}

/// Another one may have taken over when this program was held up for so long that its lease ran
/// out.
bool RunningRecording::isStillOurs() {
    const auto read = readRecordingFile(m_place.recordingFile());
    if (!read || !read.value() || read.value()->writer == m_file.writer)
        return true;
    refuse(takenOverText(*read.value()));
    return false;
}

void RunningRecording::renew() {
    m_next_beat = std::chrono::steady_clock::now() + m_pace.beat;
    m_file.lease_until_s = unixSeconds() + m_pace.lease.count();
    store();
}

/// Where the file cannot be written, as on a full disk, the pictures themselves tell it.
void RunningRecording::store() const {
    const Protection protection = m_overwrites ? Protection::overridden : Protection::respected;
    (void)writeRecordingFile(m_place.recordingFile(), m_file, protection).ok();
}

std::optional<RecordingReport> RunningRecording::end() {
    if (m_state == State::waiting)
        return std::nullopt;
    RecordingReport report;
    report.folder = m_place.folder;
    report.page = m_place.page();
    report.expected = m_place.frames;
    report.written = m_written;
    lookThroughFolder(report);
    std::error_code error;
    report.has_page = m_page_is_written && fs::is_regular_file(report.page, error);
    const FolderLock lock(m_place.folder);
    if (m_state == State::running && isStillOurs())
        noteEnd();
    return report;
}

/// Counts the pictures of this recording, and keeps of the earlier ones those that are there.
void RunningRecording::lookThroughFolder(RecordingReport& report) {
    const PicturesByExtension earlier = std::exchange(m_file.earlier, {});
    std::string first_left_over;
    std::error_code error;
    for (fs::directory_iterator at(m_place.folder, error), end; !error && at != end;
         at.increment(error)) {
        const std::string name = at->path().filename().native();
        const auto own = frameOf(name);
        if (own && m_file.written.has(*own)) {
            ++report.there;
        } else if (keepIfOf(earlier, name)) {
            ++report.left_over;
            first_left_over = first_left_over.empty() ? name : std::min(first_left_over, name);
        }
    }
    report.first_left_over = KM_wString::FromUtf8(first_left_over);
}

/// Keeps a picture of an earlier recording. @return false for every other file
bool RunningRecording::keepIfOf(const PicturesByExtension& earlier, const std::string& name) {
    for (const auto& [extension, frames] : earlier) {
        const auto frame = FrameNames{m_place.animation, extension}.frameOf(name);
        if (frame && frames.has(*frame)) {
            m_file.earlier[extension].add(*frame);
            return true;
        }
    }
    return false;
}

void RunningRecording::noteEnd() {
    m_file.is_running = false;
    m_file.owns_page = m_page_is_written || m_owned_page;
    std::error_code error;
    if (m_written > 0 || m_file.owns_page || !m_file.earlier.empty())
        store();
    else
        fs::remove(m_place.recordingFile(), error); // it would tell of nothing
}

} // namespace quarn
