#include "host/session/Recovery.h"

#include "host/app/Application.h"
#include "host/front_end/StateFolder.h"
#include "host/recovery/RecoveryMarks.h"
#include "host/recovery/RecoverySnapshot.h"
#include "host/recovery/RecoveryWorker.h"
#include "host/session/Session.h"

#include <algorithm>
#include <exception>
#include <utility>

namespace quarn {

namespace {

using Clock = RecoveryWorker::Clock;

/// Of objects in one look: those of a document of many thousand take several.
constexpr Clock::duration LONGEST_COPYING = std::chrono::milliseconds(2);
/// Before some dozens of quick commands it is looked each time.
constexpr Clock::duration MOST_CREDIT = std::chrono::milliseconds(100);

std::filesystem::path stateFolderOf(const RecoveryOptions& options) {
    return options.state_folder.empty() ? userStateFolder() : options.state_folder;
}

} // namespace

struct RecoveryKeeper::State {
    explicit State(const RecoveryOptions& options)
        : every(options.every), worker(stateFolderOf(options)), next_look(Clock::now() + every) {}

    static Application& application() { return *Application::current(); }
    static Document& document() { return *application().documents().active(); }

    void followDocument();
    void look(Clock::time_point time_to_write, Clock::duration longest);
    void lookWhereDue();
    void lookBeforeCommand();
    /// Whether there is something to show now that there was not when the document was kept.
    bool hasFirstPicture() const {
        return shown == ShownView{} && document().activeView().frameBuffer().width > 0;
    }
    void handOver(RecoveryMatter now, const std::shared_ptr<const ObjectCopies>& objects,
                  Clock::time_point time_to_write);
    void dropAll();
    void noteTrouble(const std::optional<std::string>& why);

    const Clock::duration every;
    RecoveryWorker worker;
    Clock::time_point next_look;
    Clock::duration credit = MOST_CREDIT;         ///< that looks before commands may take now
    Clock::time_point credit_time = Clock::now(); ///< when it was reckoned

    unsigned serial_number = 0;           ///< of the document that is followed; 0: none yet
    unsigned save_count = 0;              ///< of the same
    std::filesystem::path recovered_from; ///< mark of the file that it came from
    bool is_kept = false;                 ///< its recovery file is there, or is being made
    std::optional<RecoveryMatter> known;  ///< as it was kept, or forgotten, last
    ShownView shown;
    bool outlives = false; ///< the recovery file does

    std::string known_trouble; ///< empty: there was none at the last look
    std::optional<std::string> news;
};

/// Another document, and one that was saved, needs nothing of what was kept. One that was recovered
/// is kept at once, so that its recovery file is this program's own.
void RecoveryKeeper::State::followDocument() {
    const Document& now = document();
    const bool is_another = now.serialNumber() != serial_number;
    if (!is_another && now.saveCount() == save_count)
        return;
    dropAll();
    serial_number = now.serialNumber();
    save_count = now.saveCount();
    if (is_another && !now.recoveredFrom().empty()) {
        recovered_from = now.recoveredFrom();
        next_look = {};
    }
}

void RecoveryKeeper::State::dropAll() {
    known.reset();
    shown = {};
    const std::filesystem::path other_mark = std::exchange(recovered_from, {});
    if (std::exchange(is_kept, false) || !other_mark.empty())
        worker.remove(other_mark);
}

/// Objects that were not copied since they changed are copied also where the document is not
/// modified yet: those of a large document that was opened just now take several looks.
void RecoveryKeeper::State::look(Clock::time_point time_to_write, Clock::duration longest) {
    try {
        const auto objects = document().objectCopies(Clock::now() + longest);
        RecoveryMatter now = recoveryMatterOf(document());
        if (!document().isModified(now.saved))
            dropAll();
        else if (objects && (now != known || worker.isInTrouble() || hasFirstPicture()))
            handOver(std::move(now), objects, time_to_write);
        if (!objects)
            next_look = {};
    } catch (const std::exception&) {
        noteTrouble("There is too little memory to keep unsaved work for recovery.");
    }
}

void RecoveryKeeper::State::handOver(RecoveryMatter now,
                                     const std::shared_ptr<const ObjectCopies>& objects,
                                     Clock::time_point time_to_write) {
    RecoverySnapshot snapshot = snapshotOf(document(), objects, shown);
    noteTrouble(snapshot.trouble);
    worker.keep(std::move(snapshot.state), time_to_write, recovered_from);
    is_kept = true;
    known = std::move(now);
}

void RecoveryKeeper::State::lookWhereDue() {
    followDocument();
    const Clock::time_point now = Clock::now();
    if (now < next_look)
        return;
    next_look = now + every;
    look(now, LONGEST_COPYING);
}

/// A command may run for hours. What it begins with is handed over, to be written when the next
/// look would be due. Looking before thousands of quick commands takes at most a twentieth of the
/// time.
void RecoveryKeeper::State::lookBeforeCommand() {
    constexpr int share = 20;
    lookWhereDue();
    const Clock::time_point begin = Clock::now();
    credit = std::min(MOST_CREDIT, credit + (begin - credit_time) / share);
    credit_time = begin;
    if (credit <= Clock::duration::zero())
        return;
    look(next_look, LONGEST_COPYING);
    credit -= Clock::now() - begin;
}

void RecoveryKeeper::State::noteTrouble(const std::optional<std::string>& why) {
    if (why && *why != known_trouble)
        news = why;
    known_trouble = why.value_or("");
}

RecoveryKeeper::RecoveryKeeper(Session&, RecoveryOptions options)
    : m_state(std::make_unique<State>(options)) {
    State& state = *m_state;
    state.followDocument();
    State::application().runner().setBeforeCommand([&state] { state.lookBeforeCommand(); });
}

RecoveryKeeper::~RecoveryKeeper() {
    State::application().runner().setBeforeCommand({});
    m_state->followDocument();
    if (!m_state->outlives || !State::document().isModified())
        m_state->dropAll();
}

void RecoveryKeeper::beat() {
    if (!State::application().runner().current())
        m_state->lookWhereDue();
}

std::optional<std::string> RecoveryKeeper::keepNow() {
    if (State::application().runner().current())
        return "Unsaved work is kept when the command that runs has ended.";
    m_state->followDocument();
    m_state->outlives = true;
    m_state->look(Clock::now(), std::chrono::hours(1));
    const auto kept = m_state->worker.finish();
    return kept ? takeTrouble() : std::optional(kept.message());
}

void RecoveryKeeper::forget() {
    m_state->followDocument();
    m_state->dropAll();
    m_state->known = recoveryMatterOf(State::document());
    m_state->worker.waitUntilRemoved();
}

std::optional<std::string> RecoveryKeeper::takeTrouble() {
    auto news = std::exchange(m_state->news, std::nullopt);
    return news ? news : m_state->worker.takeTrouble();
}

std::vector<RecoverableDocument> recoverableDocuments(const RecoveryOptions& options) {
    return recoverableIn(stateFolderOf(options));
}

std::optional<std::string> recover(Session& session, const RecoverableDocument& document) {
    if (session.isCommandRunning())
        return "A document is recovered when the command that runs has ended.";
    Application& application = *Application::current();
    const auto opened = openRecovered(application.documents(), document);
    if (!opened)
        return opened.message();
    for (const std::string& line : opened.value())
        application.tell(line);
    application.documents().commandEnded();
    return std::nullopt;
}

void discard(const RecoverableDocument& document) {
    removeRecovery(document.mark);
}

bool fileIsNewer(const RecoverableDocument& document) {
    return hasNewerFile(document);
}

std::string recoverableText(const RecoverableDocument& document) {
    return textOf(document);
}

} // namespace quarn
