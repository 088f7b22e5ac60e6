#include "host/recording/RunningRecording.h"

#include "host/recording/FrameNames.h"
#include "sdk/qncore/QnLocalize.h"

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

fs::path parentOf(const fs::path& file) {
    return file.lexically_normal().parent_path();
}

double secondsSince(std::chrono::steady_clock::time_point start) {
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

} // namespace

RunningRecording::RunningRecording(RecordingPlan plan, Listener listener)
    : RunningRecording(std::move(plan), std::move(listener), Pace()) {}

RunningRecording::RunningRecording(RecordingPlan plan, Listener listener, Pace pace)
    : m_plan(std::move(plan)), m_listener(std::move(listener)),
      m_pace(pace), m_place{{},
                            m_plan.animation,
                            m_plan.settings.extension,
                            m_plan.settings.frames},
      m_file(recordingFileOf(m_plan, m_plan.fingerprint())),
      m_wanted(m_plan.choice.frames ? *m_plan.choice.frames
                                    : FrameSet::firstOf(m_plan.settings.frames)) {}

std::optional<int> RunningRecording::frameOf(const fs::path& file) const {
    return FrameNames{m_place.animation, m_place.extension}.frameOf(file.filename().native());
}

bool RunningRecording::isPage(const fs::path& file) const {
    return file.filename().native() == pageName(m_place.animation);
}

bool RunningRecording::isInPlace(const fs::path& file) const {
    return parentOf(file) == m_parent && (isPage(file) || frameOf(file));
}

bool RunningRecording::makesNext() {
    return m_state != State::running || m_next >= m_place.frames || needOf(m_next) == Need::to_make;
}

RunningRecording::Need RunningRecording::needOf(int frame) {
    if (!m_decided || m_decided->first != frame) {
        m_claim.reset();
        m_decided = {frame, decide(frame)};
        m_frame_start = Clock::now();
    }
    return m_decided->second;
}

RunningRecording::Need RunningRecording::decide(int frame) {
    if (!m_wanted.has(frame))
        return Need::not_asked_for;
    if (!m_file.is_shared)
        return Need::to_make;
    if (isKept(frame))
        return Need::kept;
    m_claim = FrameClaim::take(m_place.folder / claimName(m_place.animation, frame), claimer());
    if (!m_claim)
        return Need::elsewhere;
    if (!isKept(frame)) // another one may have made it just now
        return Need::to_make;
    m_claim.reset();
    return Need::kept;
}

bool RunningRecording::isKept(int frame) {
    const FrameNames names{m_place.animation, m_place.extension};
    std::error_code error;
    if (!fs::exists(m_place.folder / names.fileName(frame), error))
        return false;
    if (const ManifestFrame* const known = m_known->find(frame); known && m_known->isWhole(*known))
        return true;
    m_known->refresh();
    const ManifestFrame* const known = m_known->find(frame);
    return known && m_known->isWhole(*known);
}

bool RunningRecording::passesOver(const fs::path& file) {
    if (m_state != State::running || !isInPlace(file))
        return false;
    if (isPage(file))
        return !isWhole() || !hasAllSoFar();
    const int frame = *frameOf(file);
    const Need need = needOf(frame);
    m_has_passed_over = need != Need::to_make;
    if (need == Need::kept)
        m_kept.add(frame);
    if (need == Need::elsewhere)
        m_elsewhere.add(frame);
    if (m_has_passed_over)
        m_next = frame + 1;
    return m_has_passed_over;
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
    m_made.add(*frame);
    m_next = *frame + 1;
    beat();
    return frame;
}

void RunningRecording::note(ManifestFrame frame) {
    if (m_state != State::running)
        return;
    const bool is_timed = m_decided && m_decided->first == frame.number;
    const double seconds = is_timed ? secondsSince(m_frame_start) : 0.0;
    m_known->put(frame);
    const auto noted = m_journal ? m_journal->add({std::move(frame), seconds}) : Result<void>();
    m_claim.reset();
    if (!noted && m_file.is_shared)
        refuse(noted.message());
}

void RunningRecording::beat() {
    if (m_state == State::running && Clock::now() >= m_next_beat && isStillOurs())
        renew();
}

/// Another one may have begun anew when this program was held up for so long that its lease ran
/// out.
bool RunningRecording::isStillOurs() {
    const auto read = readRecordingFile(m_place.recordingFile());
    if (!read || !read.value() || read.value()->writer == m_file.writer)
        return true;
    refuse(takenOverText(*read.value()));
    return false;
}

void RunningRecording::renew() {
    m_next_beat = Clock::now() + m_pace.beat;
    if (m_journal)
        m_journal->renew();
}

/// Where the file cannot be written, as on a full disk, the pictures themselves tell it.
void RunningRecording::store() const {
    const Protection protection =
        m_plan.overwrites ? Protection::overridden : Protection::respected;
    (void)writeRecordingFile(m_place.recordingFile(), m_file, protection).ok();
}

void RunningRecording::refuse(const std::string& why) {
    m_state = State::refused;
    m_trouble = why;
    m_listener.tell(why);
}

} // namespace quarn
