#pragma once

#include "host/session/Session.h"

#include <QObject>
#include <QWidget>

namespace quarn::desktop {

class CommandStarter;

/// Asks what is to become of unsaved changes before a document is left.
class UnsavedChanges final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this.
    /// @param window  the questions stand before it
    UnsavedChanges(Session& session, CommandStarter& starter, QWidget& window);

    /// Whether the document may be left: it holds nothing unsaved, or the person had it saved, or
    /// does not want it. False when the person gave up, or the document could not be saved.
    bool mayLeave();

public slots:
    /// Starts a command line that a person gave; one that leaves the document only when it may be
    /// left.
    void start(const QString& line);

private:
    enum class Choice { save, discard, stay };
    Choice askPerson();
    bool save();

    Session& m_session;
    CommandStarter& m_starter;
    QWidget& m_window;
    bool m_may_exit = false; ///< answered already, by the command that ends the program
};

} // namespace quarn::desktop
