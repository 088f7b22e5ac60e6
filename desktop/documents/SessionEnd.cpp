#include "desktop/documents/SessionEnd.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/documents/WindowClosing.h"
#include "host/session/DocumentState.h"

#include <QEvent>
#include <QGuiApplication>
#include <QSessionManager>

namespace quarn::desktop {

SessionEnd::SessionEnd(Session& session, CommandStarter& starter, WindowClosing& closing,
                       UnsavedChanges& changes, ProgramEnd& end, QObject* parent)
    : QObject(parent), m_session(session), m_starter(starter), m_closing(closing),
      m_changes(changes), m_end(end) {
    connect(&starter, &CommandStarter::started, this, [this] { m_settled.reset(); });
    connect(
        qGuiApp, &QGuiApplication::commitDataRequest, this,
        [this](QSessionManager& manager) {
            // A session that begins again would start the program with words for Qt alone.
            manager.setRestartHint(QSessionManager::RestartNever);
            prepare({[&] { return manager.allowsInteraction(); }, [&] { manager.release(); },
                     [&] { manager.cancel(); }});
        },
        Qt::DirectConnection);
    qGuiApp->installEventFilter(this);
}

void SessionEnd::prepare(const EndingSession& ending) {
    m_settled.reset();
    if (!m_starter.isRunning() && !isModified(m_session.document()))
        return;
    if (!ending.may_ask()) {
        m_settled = UnsavedWork::kept;
        emit keepsWork();
        return;
    }
    m_settled = askPerson();
    if (m_settled)
        ending.agree();
    else
        ending.cancel();
}

/// While a command runs nothing can be saved: what it has changed is kept for recovery instead.
/// @return nothing where the person wants the session to go on
std::optional<UnsavedWork> SessionEnd::askPerson() {
    if (!m_closing.mayStop())
        return std::nullopt;
    if (m_starter.isRunning()) {
        m_starter.stop();
        return UnsavedWork::kept;
    }
    if (!m_changes.mayLeave())
        return std::nullopt;
    return UnsavedWork::not_wanted;
}

/// The desktop ends its programs once all have agreed, in the way in which a person closes them;
/// what was answered already is not asked again.
bool SessionEnd::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::Quit || watched != qGuiApp || !m_settled)
        return QObject::eventFilter(watched, event);
    m_end.end(*m_settled);
    return true;
}

} // namespace quarn::desktop
