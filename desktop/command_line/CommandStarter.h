#pragma once

#include "host/session/Session.h"

#include <QObject>

#include <functional>

namespace quarn::desktop {

class DesktopFrontEnd;

/// The one way in which the window starts commands: menus, command line, animation bar and mouse
/// all come here. One command runs at a time.
class CommandStarter : public QObject {
    Q_OBJECT

public:
    /// Session and front end must outlive this.
    CommandStarter(Session& session, DesktopFrontEnd& front_end, QObject* parent = nullptr);

    bool isRunning() const;
    /// The line of the running command; empty while none runs.
    const QString& line() const { return m_line; }

public slots:
    /// Runs a command line now, as typed by a person who may be shown dialogs; returns when the
    /// command has ended. While another one runs nothing is started and the person is told.
    void start(const QString& line);
    /// Runs the command lines of a script file one after the other, without dialogs; to whoever
    /// watches, as one command. @return whether every command succeeded
    bool startScript(const QString& file);
    /// Does something that is no command in the way of one: while it runs nothing else is started.
    /// @param name  what it is called, as a command line would be shown
    void startWork(const QString& name, const std::function<CQuarnCommand::result()>& work);
    /// Asks the running command to end: until the outermost command has ended, the front end
    /// counts as interrupted and Escape as held down. Without one it does nothing.
    void stop();
    /// Stops what runs, and starts nothing any more: the program ends.
    void stopForGood();

signals:
    void started(const QString& line);
    /// The outermost command has ended. Views and documents may be others than before.
    void ended(CQuarnCommand::result result);
    /// A line was not started, and why, in one sentence.
    void refused(const QString& reason);

private:
    void refuse();

    Session& m_session;
    DesktopFrontEnd& m_front_end;
    QString m_line;
    bool m_is_started = false;
    bool m_is_over = false;
};

} // namespace quarn::desktop
