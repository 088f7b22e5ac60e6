#include "host/recording/RunningRecording.h"

#include "ground/PathText.h"
#include "host/recording/FrameNames.h"
#include "host/recording/FramesManifest.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <thread>
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

Error beyondTheEnd(const RecordingPlan& plan, int last) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"There is no frame %d: the animation %s has the frames 0 to %d.",
                                 42862),
                last, KM_wString::FromUtf8(plan.animation).Array(), plan.settings.frames - 1)
                .ToUtf8()};
}

/// The folder as the parent path of a file in it reads.
fs::path folderAsParent(const fs::path& folder) {
    return (folder / "file").lexically_normal().parent_path();
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

// ---- The beginning

bool RunningRecording::begin(const fs::path& folder) {
    if (m_state != State::waiting)
        return m_state == State::running || folderAsParent(folder) != m_parent;
    m_place.folder = folder;
    m_parent = folderAsParent(folder);
    if (!openJournal())
        return false;
    const auto alone = claimBeginning();
    if (const auto started = start(); !started) {
        refuse(started.message());
        return false;
    }
    m_state = State::running;
    renew();
    m_known.emplace(KnownFrames::Place{m_place.folder, m_place.animation}, m_file.fingerprint);
    tellStart();
    return true;
}

/// Where a recording that nobody shares cannot note its frames, as on a full disk, the pictures
/// themselves tell it.
bool RunningRecording::openJournal() {
    JournalHead head{m_place.animation, m_file.writer, m_file.fingerprint,
                     secondsSinceProcessStart()};
    auto journal = JournalWriter::create(m_place.folder, head);
    if (journal)
        m_journal.emplace(std::move(journal.value()));
    else if (m_file.is_shared)
        refuse(journal.message());
    return m_state == State::waiting;
}

/// Of many that begin at once each looks at the folder alone. Whoever holds it for long is not
/// waited for.
std::optional<FrameClaim> RunningRecording::claimBeginning() {
    constexpr std::chrono::milliseconds BETWEEN_TRIES{20};
    constexpr int MOST_TRIES = 500;
    if (!m_journal)
        return std::nullopt;
    const fs::path file = m_place.folder / (m_place.animation + ".begin.claim");
    for (int tries = 0; tries < MOST_TRIES; ++tries) {
        if (auto claim = FrameClaim::take(file, claimer()))
            return claim;
        std::this_thread::sleep_for(BETWEEN_TRIES);
    }
    return std::nullopt;
}

FrameClaim::Claimer RunningRecording::claimer() {
    return {m_journal->file(), [this](const std::string& journal) { return isAlive(journal); }};
}

bool RunningRecording::isAlive(const std::string& journal) {
    const fs::path file = m_place.folder / journal;
    JournalReader alone(file);
    const JournalReader* reader = m_known ? m_known->journal(journal) : nullptr;
    if (!m_known && alone.readOn())
        reader = &alone;
    return reader && isWriterAlive(*reader, m_journal->renew(), m_pace.lease);
}

Result<void> RunningRecording::start() {
    if (!m_wanted.isEmpty() && m_wanted.ranges().back().last >= m_place.frames)
        return beyondTheEnd(m_plan, m_wanted.ranges().back().last);
    auto read = readRecordingFile(m_place.recordingFile());
    const bool is_known = read && read.value();
    const auto difference =
        is_known ? whyAnotherRecording(*read.value(), m_file, m_place.folder) : std::nullopt;
    const bool may_go_on = m_plan.choice.begin != RecordingBegin::anew;
    const bool goes_on = may_go_on && is_known && !difference;
    // First: others that are refused for the same reason stand in the folder for a moment too.
    if (m_plan.choice.begin == RecordingBegin::resume && difference)
        return Error{*difference};
    // Without that file nobody has begun: whoever has a journal waits for this one.
    if (is_known && (!goes_on || !read.value()->is_shared))
        if (const auto other = otherWriter())
            return isRecorded(m_place, *other);
    if (!goes_on)
        return startAnew();
    join(std::move(*read.value()));
    return {};
}

std::optional<ProcessIdentity> RunningRecording::otherWriter() const {
    return whoRecords(m_place, m_journal ? m_journal->file() : fs::path(), m_pace.lease);
}

Result<void> RunningRecording::startAnew() {
    const Result<OwnFiles> own = checkRecordingPlace(m_place, m_plan.overwrites);
    if (!own)
        return own.error();
    m_owned_page = own.value().owns_page;
    m_file.earlier = own.value().pictures;
    std::error_code error;
    fs::remove(m_place.folder / manifestName(m_place.animation), error); // tells of replaced frames
    for (const fs::path& journal : journalsIn(m_place.folder, m_place.animation))
        if (!m_journal || (journal != m_journal->file() && !isAlive(journal.filename().native())))
            fs::remove(journal, error);
    if (m_wanted.isEmpty())
        m_file.fingerprint.instructions.clear(); // the first to make a frame decides
    store();
    return {};
}

/// Goes on with what is there. It counts as not ended until all frames are made.
void RunningRecording::join(RecordingFile there) {
    m_owned_page = there.owns_page;
    const bool takes_instructions = there.fingerprint.instructions.empty() && !m_wanted.isEmpty();
    if (takes_instructions)
        there.fingerprint.instructions = m_file.fingerprint.instructions;
    const bool changes = takes_instructions || !there.is_running || !there.is_shared;
    if (there.document.empty())
        there.document = m_file.document;
    m_file = std::move(there);
    m_file.is_running = true;
    m_file.is_shared = true;
    if (changes)
        store();
}

/// Which frames are whole is seen when they come; until then their sizes tell.
void RunningRecording::tellStart() {
    RecordingStart start{m_wanted.count(), 0};
    if (m_file.is_shared && isAnyThere())
        m_known->refresh();
    for (const auto& [number, frame] : m_known->frames())
        start.kept += m_wanted.has(number) && m_known->isThere(frame);
    m_listener.begun(start);
}

/// Whether there is a file of a wanted frame: else there is no need to read the journals of all.
bool RunningRecording::isAnyThere() const {
    std::error_code error;
    for (fs::directory_iterator at(m_place.folder, error), end; !error && at != end;
         at.increment(error))
        if (const auto frame = frameOf(at->path()); frame && m_wanted.has(*frame))
            return true;
    return false;
}

void RunningRecording::refuse(const std::string& why) {
    m_state = State::refused;
    m_trouble = why;
    m_listener.tell(why);
}

// ---- The frames

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

// ---- Keeping alive

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

// ---- The end

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
