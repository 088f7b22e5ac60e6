#pragma once

#include "desktop/menus/MenuTable.h"
#include "host/session/Session.h"

#include <QAction>
#include <QMenuBar>

#include <map>

namespace quarn::desktop {

class CommandStarter;

/// Every command of the session in the menus of a window, each once. What a menu calls a command is
/// in the words of the user; tips tell its name and what it does.
class CommandMenus final : public QObject {
    Q_OBJECT
public:
    /// Fills an empty menu bar. While a command runs its actions are disabled, and "Stop" enabled.
    /// All that is named must outlive this.
    CommandMenus(Session& session, CommandStarter& starter, QMenuBar& bar);

    /// A menu, to add what is no command: recent files, display modes, the look of the window.
    QMenu& menu(MenuPlace place) { return *m_menus.at(place); }
    /// The action of a command; null for a name that is none of the session's.
    /// @param name  the English one
    QAction* action(const QString& name) const;
    /// Puts actions that are no command below the action of one, in their order.
    void addBelow(const QString& name, const QList<QAction*>& actions);
    QAction& stopAction() { return *m_stop; }

public slots:
    /// Looks which commands there are now: a plug-in that was loaded brings its own.
    void refresh();

signals:
    /// A command was chosen. It is not started here.
    void lineChosen(const QString& line);

private:
    QAction& addCommand(QMenu& menu, const QString& name, const QString& label);
    void addRows();
    void addStop();
    void setCommandRuns(bool runs);
    QString lineOf(const QString& name);

    Session& m_session;
    std::map<MenuPlace, QMenu*> m_menus;
    std::map<QString, QAction*> m_actions; ///< by English name, also of commands that are not there
    QAction* m_stop = nullptr;
};

} // namespace quarn::desktop
