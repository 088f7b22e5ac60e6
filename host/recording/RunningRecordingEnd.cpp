// What is told of a recording at its end, and what it leaves in its folder.
#include "host/recording/FrameNames.h"
#include "host/recording/RunningRecording.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;

} // namespace

std::optional<RecordingReport> RunningRecording::end() {
    if (m_state == State::waiting)
        return std::nullopt;
    m_claim.reset();
    RecordingReport report;
    report.folder = m_place.folder;
    report.page = m_place.page();
    report.expected = m_wanted.count();
    report.written = m_made.count();
    report.kept = m_kept.count();
    report.elsewhere = m_elsewhere.count();
    report.is_part = !isWhole();
    lookThroughFolder(report);
    std::error_code error;
    report.has_page = m_page_is_written && fs::is_regular_file(report.page, error);
    if (m_state == State::running && isStillOurs())
        noteEnd();
    else if (m_journal)
        endPart();
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
        if (own && (m_made.has(*own) || m_kept.has(*own))) {
            ++report.there;
        } else if (!(own && m_known && m_known->find(*own)) && keepIfOf(earlier, name)) {
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
    m_known->refresh();
    const bool has_all = m_made.count() + m_kept.count() == m_place.frames;
    if (isWhole() && (has_all || (hasAllSoFar() && !otherWriter())))
        endWhole();
    else
        endPart();
}

/// Leaves the recording to whoever goes on with it. One that wrote nothing leaves nothing.
void RunningRecording::endPart() {
    if (!m_journal)
        return;
    if (m_made.isEmpty())
        m_journal->remove();
    else
        m_journal->end(m_trouble);
}

/// The list of frames takes the place of the journals, where it can be written.
void RunningRecording::endWhole() {
    if (!m_file.is_shared)
        m_file.fingerprint = m_plan.fingerprint(); // of a camera that was moved until Enter came
    m_file.is_running = false;
    m_file.owns_page = m_page_is_written || m_owned_page;
    m_file.written.add(m_made);
    for (const auto& [number, frame] : m_known->frames())
        m_file.written.add(number);
    std::error_code error;
    if (m_file.written.isEmpty() && !m_file.owns_page && m_file.earlier.empty())
        fs::remove(m_place.recordingFile(), error); // it would tell of nothing
    else
        store();
    if (!writeManifest())
        return endPart();
    removeDeadClaims();
    removeEndedJournals();
}

FramesManifest RunningRecording::manifest() const {
    FramesManifest manifest;
    manifest.program = m_file.fingerprint.program;
    manifest.name = m_place.animation;
    manifest.kind = m_file.settings.kind;
    manifest.frames = m_file.settings.frames;
    manifest.width_px = m_file.settings.width_px;
    manifest.height_px = m_file.settings.height_px;
    manifest.mode = m_file.settings.mode;
    manifest.extension = m_file.settings.extension;
    manifest.frame_rate = standardFrameRate(manifest.frames);
    manifest.metres_per_unit = m_plan.metres_per_unit;
    manifest.place = m_plan.place;
    manifest.document = m_file.fingerprint.document;
    manifest.settings = m_file.fingerprint.settings;
    manifest.instructions = m_file.fingerprint.instructions;
    for (const auto& [number, frame] : m_known->frames())
        if (m_known->isThere(frame))
            manifest.images.push_back(frame);
    return manifest;
}

bool RunningRecording::writeManifest() {
    const FramesManifest listed = manifest();
    if (listed.images.empty())
        return true;
    const auto written =
        writeFramesManifest(m_place.folder / manifestName(m_place.animation), listed);
    const bool is_complete = static_cast<int>(listed.images.size()) == m_place.frames;
    if (!written && is_complete) // else the reason was told with the frames
        m_listener.tell(written.message());
    return written.ok();
}

/// A program that is still alive may write more of the same frames.
void RunningRecording::removeEndedJournals() {
    std::error_code error;
    const fs::path own = m_journal ? m_journal->file() : fs::path();
    for (const JournalReader& journal : m_known->journals())
        if (journal.file() != own && journal.content().head.animation == m_place.animation &&
            !isAlive(journal.file().filename().native()))
            fs::remove(journal.file(), error);
    if (m_journal)
        m_journal->remove();
}

/// Of programs that were killed between a frame and the end of its claim.
void RunningRecording::removeDeadClaims() {
    if (!m_journal || !m_file.is_shared)
        return;
    const FrameNames names{m_place.animation, "claim"};
    std::vector<fs::path> claims;
    std::error_code error;
    for (fs::directory_iterator at(m_place.folder, error), end; !error && at != end;
         at.increment(error))
        if (names.frameOf(at->path().filename().native()))
            claims.push_back(at->path());
    for (const fs::path& claim : claims)
        (void)FrameClaim::take(claim, claimer()); // and gives it back
}

} // namespace quarn
