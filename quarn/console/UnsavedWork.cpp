#include "quarn/console/UnsavedWork.h"

#include "host/session/DocumentState.h"
#include "quarn/words/Words.h"

#include <algorithm>

namespace quarn::program {

namespace {

using namespace std::chrono_literals;

/// The keeper itself knows when it is time; it is looked after a few times in each beat.
std::chrono::milliseconds betweenLooks(std::chrono::milliseconds every) {
    return std::clamp<std::chrono::milliseconds>(every / 4, 20ms, 1s);
}

} // namespace

UnsavedWork::UnsavedWork(Session& session, TerminalFrontEnd& front_end, LineSource& lines,
                         const std::optional<RecoveryOptions>& options)
    : m_session(session), m_front_end(front_end), m_lines(lines), m_options(options) {
    if (!options)
        return;
    m_keeper.emplace(session, *options);
    lines.setIdleWork([this] { m_keeper->beat(); }, betweenLooks(options->every));
}

UnsavedWork::~UnsavedWork() {
    m_lines.setIdleWork({}, {});
}

void UnsavedWork::offer() const {
    const auto documents =
        m_options ? recoverableDocuments(*m_options) : std::vector<RecoverableDocument>();
    if (documents.empty())
        return;
    const bool is_one = documents.size() == 1;
    m_front_end.print(is_one ? L"This document was not saved when its program ended:\n"
                             : L"These documents were not saved when their programs ended:\n");
    for (const RecoverableDocument& document : documents)
        m_front_end.print(L"  " + wideText(recoverableText(document)) + L"\n");
    m_front_end.print(is_one ? L"Recover opens or discards it.\n"
                             : L"Recover opens or discards one of them.\n");
}

void UnsavedWork::look() {
    if (!m_keeper)
        return;
    m_keeper->beat();
    if (const auto trouble = m_keeper->takeTrouble())
        m_front_end.print(wideText(*trouble) + L"\n");
}

std::string UnsavedWork::keepForNextStart() {
    if (!m_keeper || !isModified(m_session.document()))
        return {};
    if (const auto trouble = m_keeper->keepNow())
        return "quarn: " + *trouble;
    return "quarn: what was not saved is kept; the next quarn console offers it.";
}

} // namespace quarn::program
