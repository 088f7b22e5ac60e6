#pragma once

#include <QObject>

namespace quarn::desktop {

class CommandPane;
class CommandStarter;

/// What becomes of unsaved work when the program ends.
enum class UnsavedWork {
    kept,       ///< for recovery: nobody could be asked
    not_wanted, ///< the person was asked about it
};

/// Ends the program where nobody closes its window: somebody asked it to stop from outside, or the
/// desktop session is over.
class ProgramEnd final : public QObject {
    Q_OBJECT
public:
    /// Both must outlive this.
    ProgramEnd(CommandStarter& starter, CommandPane& pane, QObject* parent);

    /// From now on Ctrl-C, a request to terminate and the end of the terminal end the program as
    /// end() does, and unsaved work is kept; a second one, and a program that hangs, end it at
    /// once.
    void watchSignals();

    /// Ends the program without a question: the running command is stopped, dialogs and questions
    /// are given up, and the application's event loop returns as soon as all that waits in it has.
    void end(UnsavedWork work);
    /// What becomes of unsaved work. Who closes the window was asked about it.
    UnsavedWork unsavedWork() const { return m_work; }

private:
    CommandStarter& m_starter;
    CommandPane& m_pane;
    UnsavedWork m_work = UnsavedWork::not_wanted;
};

} // namespace quarn::desktop
