// How a recording begins in its folder: anew, or as a part of one that is there.
#include "host/recording/FrameNames.h"
#include "host/recording/RunningRecording.h"
#include "sdk/qncore/QnLocalize.h"

#include <thread>

namespace quarn {

namespace {

namespace fs = std::filesystem;

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

} // namespace

bool RunningRecording::begin(const fs::path& folder) {
    if (m_state != State::waiting)
        return m_state == State::running || folderAsParent(folder) != m_parent;
    m_place.folder = folder;
    m_parent = folderAsParent(folder);
    if (!m_plan.refusal.empty())
        refuse(m_plan.refusal);
    if (m_state != State::waiting || !openJournal())
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
    const auto now = m_journal ? m_journal->renew() : timeOfDisk(m_place.folder);
    return reader && isWriterAlive(*reader, now, m_pace.lease);
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
        if (!(m_journal && journal == m_journal->file()) && !isAlive(journal.filename().native()))
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

} // namespace quarn
