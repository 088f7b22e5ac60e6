#pragma once

#include "desktop/documents/ProgramEnd.h"
#include "host/session/Session.h"

#include <functional>
#include <optional>

namespace quarn::desktop {

class UnsavedChanges;
class WindowClosing;

/// The end of a desktop session, as the desktop offers it to its programs one after the other.
struct EndingSession {
    std::function<bool()> may_ask; ///< whether the person may be asked something now
    std::function<void()> agree;   ///< after a question: the session may end
    std::function<void()> cancel;  ///< after a question: the session is to go on
};

/// Decides what becomes of unsaved work when the desktop session ends: the person is asked about it
/// and may have the session go on; where nobody may be asked, it is kept for recovery.
class SessionEnd final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this.
    SessionEnd(Session& session, CommandStarter& starter, WindowClosing& closing,
               UnsavedChanges& changes, ProgramEnd& end, QObject* parent);

    /// The desktop is about to end the session.
    void prepare(const EndingSession& ending);

signals:
    /// Unsaved work is to be kept for recovery now.
    void keepsWork();

private:
    bool eventFilter(QObject* watched, QEvent* event) override;
    std::optional<UnsavedWork> askPerson();

    Session& m_session;
    CommandStarter& m_starter;
    WindowClosing& m_closing;
    UnsavedChanges& m_changes;
    ProgramEnd& m_end;
    std::optional<UnsavedWork> m_settled; ///< until something is changed again
};

} // namespace quarn::desktop
