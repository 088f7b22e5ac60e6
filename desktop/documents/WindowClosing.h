#pragma once

#include "sdk/qncore/QnCommand.h"

#include <QObject>
#include <QWidget>

namespace quarn::desktop {

class CommandPane;
class CommandStarter;
class UnsavedChanges;

/// Decides whether a window may be closed, and closes it later where a command has to end first.
class WindowClosing final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this.
    WindowClosing(CommandStarter& starter, CommandPane& pane, UnsavedChanges& changes,
                  QWidget& window);

    /// For the window's closeEvent. A question that is asked is cancelled; a command that runs is
    /// ended, if the person wants that; unsaved changes are asked about. Where false is returned
    /// because a command has to end, the window is closed once it has.
    bool mayClose();
    /// Whether a command that runs may be stopped: none does, it only waits for an answer, or the
    /// person agrees.
    bool mayStop();

private:
    bool askToStop();
    void commandEnded();

    CommandStarter& m_starter;
    CommandPane& m_pane;
    UnsavedChanges& m_changes;
    QWidget& m_window;
    bool m_closes_afterwards = false;
};

} // namespace quarn::desktop
