#include "desktop/menus/CommandMenus.h"

#include "desktop/animation/AnimationSummary.h"
#include "desktop/command_line/CommandStarter.h"
#include "desktop/texts/Texts.h"

#include <algorithm>

namespace quarn::desktop {

namespace {

/// "Places the camera …  (Camera)"
QString tipOf(const CommandName& command) {
    return QString("%1  (%2)").arg(qtText(command.description), qtText(command.local));
}

} // namespace

CommandMenus::CommandMenus(Session& session, CommandStarter& starter, QMenuBar& bar)
    : QObject(&bar), m_session(session) {
    for (const MenuTitle& title : menuTitles()) {
        QMenu* const menu = bar.addMenu(localized(title.title, title.title_id));
        menu->setToolTipsVisible(true);
        m_menus[title.place] = menu;
    }
    addRows();
    addStop();
    connect(m_stop, &QAction::triggered, &starter, &CommandStarter::stop);
    connect(&starter, &CommandStarter::started, this, [this] { setCommandRuns(true); });
    connect(&starter, &CommandStarter::ended, this, [this] {
        refresh();
        setCommandRuns(false);
    });
    refresh();
    setCommandRuns(starter.isRunning());
}

QAction* CommandMenus::action(const QString& name) const {
    const auto found = m_actions.find(name);
    return found != m_actions.end() && found->second->isVisible() ? found->second : nullptr;
}

void CommandMenus::addBelow(const QString& name, const QList<QAction*>& actions) {
    QAction* const above = m_actions.at(name);
    for (const auto& [place, menu] : m_menus) {
        const qsizetype index = menu->actions().indexOf(above);
        if (index >= 0)
            menu->insertActions(menu->actions().value(index + 1), actions);
    }
}

void CommandMenus::refresh() {
    std::map<QString, QAction*> gone = m_actions;
    for (const CommandName& command : m_session.commandNames()) {
        const QString name = qtText(command.english);
        QAction* action = gone[name];
        if (!action)
            action = &addCommand(menu(MenuPlace::plug_ins), name,
                                 qtText(command.local).replace('&', "&&"));
        action->setVisible(true);
        action->setToolTip(tipOf(command));
        action->setStatusTip(tipOf(command));
        gone.erase(name);
    }
    for (const auto& [name, action] : gone)
        action->setVisible(false);
}

QAction& CommandMenus::addCommand(QMenu& menu, const QString& name, const QString& label) {
    QAction* const action = menu.addAction(label);
    action->setObjectName("command_" + name);
    action->setData(name);
    connect(action, &QAction::triggered, this, [this, name] { emit lineChosen(lineOf(name)); });
    m_actions[name] = action;
    return *action;
}

void CommandMenus::addRows() {
    for (const MenuRow& row : menuRows()) {
        QMenu& menu = this->menu(row.place);
        if (row.begins_group)
            menu.addSeparator();
        QAction& action = addCommand(menu, qtText(row.command), localized(row.label, row.label_id));
        if (row.shortcut)
            action.setShortcut(QKeySequence::fromString(row.shortcut, QKeySequence::PortableText));
    }
    menu(MenuPlace::plug_ins).addSeparator();
}

void CommandMenus::addStop() {
    m_stop = new QAction(localized(L"Sto&p", 45184), this);
    m_stop->setObjectName("stop");
    m_stop->setShortcut(Qt::SHIFT | Qt::Key_F5);
    m_stop->setToolTip(localized(L"Ends the command that is running", 45187));
    m_stop->setStatusTip(m_stop->toolTip());
    addBelow("PlayAnimation", {m_stop});
}

void CommandMenus::setCommandRuns(bool runs) {
    for (const auto& [name, action] : m_actions)
        action->setEnabled(!runs);
    m_stop->setEnabled(runs);
}

/// The English name, so that a plug-in's local name never hides another command.
QString CommandMenus::lineOf(const QString& name) {
    if (name == "RecordAnimation")
        return recordingLine(m_session.document());
    const auto rows = menuRows();
    const auto row = std::ranges::find_if(
        rows, [&](const MenuRow& candidate) { return qtText(candidate.command) == name; });
    const bool has_words = row != rows.end() && row->words;
    return has_words ? "_" + name + ' ' + qtText(row->words) : "_" + name;
}

} // namespace quarn::desktop
