#pragma once

#include "host/session/Recovery.h"
#include "host/session/Session.h"

#include <QAction>
#include <QObject>
#include <QWidget>

namespace quarn::desktop {

class CommandStarter;
class UnsavedChanges;

/// Offers the unsaved work of earlier runs that ended without a person's wish. Nothing is opened
/// by itself, so that a document that ends the program does not do so at each start.
class RecoveryOffer final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this.
    /// @param window  what is asked stands before it
    RecoveryOffer(Session& session, CommandStarter& starter, UnsavedChanges& changes,
                  RecoveryOptions options, QWidget& window);

    /// Shows what there is, and does what the person decides about it; without anything it does
    /// nothing.
    /// @param wanted  a file that is about to be opened: its own unsaved work comes first
    /// @return whether a document was recovered, which is at work now
    bool offer(const std::filesystem::path& wanted = {});
    /// How many documents can be recovered.
    std::size_t count() const;
    /// Offers again what was left for later; for a menu.
    QAction& action() { return *m_action; }

signals:
    /// There is nothing to recover; one sentence for a person.
    void nothingThere(const QString& message);

private:
    void offerAgain();
    std::optional<std::string> recover(const RecoverableDocument& document);

    Session& m_session;
    CommandStarter& m_starter;
    UnsavedChanges& m_changes;
    RecoveryOptions m_options;
    QWidget& m_window;
    QAction* m_action;
};

} // namespace quarn::desktop
