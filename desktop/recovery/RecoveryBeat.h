#pragma once

#include "host/session/Recovery.h"

#include <QObject>

namespace quarn::desktop {

class CommandStarter;

/// Keeps the unsaved work of the window's session on a steady beat, and says when it cannot.
class RecoveryBeat final : public QObject {
    Q_OBJECT
public:
    /// Begins at once. Session and starter must outlive this.
    RecoveryBeat(Session& session, CommandStarter& starter, RecoveryOptions options,
                 QObject* parent);

    /// As RecoveryKeeper::keepNow; what cannot be kept is told as troubled().
    void keepNow();
    /// As RecoveryKeeper::forget.
    void forget() { m_keeper.forget(); }
    /// Where and how often it keeps.
    const RecoveryOptions& options() const { return m_options; }

signals:
    /// Why unsaved work is not kept; one sentence for a person. Each trouble comes once.
    void troubled(const QString& message);

private:
    void beat();

    RecoveryOptions m_options;
    RecoveryKeeper m_keeper;
};

} // namespace quarn::desktop
