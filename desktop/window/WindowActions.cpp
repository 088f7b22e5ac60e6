#include "desktop/window/WindowActions.h"

#include "desktop/Texts.h"
#include "desktop/menus/CommandMenus.h"
#include "desktop/views/ViewArea.h"
#include "desktop/window/MainWindow.h"

#include <QDockWidget>

namespace quarn::desktop {

void addWindowActions(MainWindow& window, QDockWidget& command_dock) {
    QMenu& menu = window.menus().menu(MenuPlace::view);
    menu.addSeparator();
    QAction* const alone = menu.addAction(localized(L"&Active view alone", 45023));
    alone->setObjectName("activeViewAlone");
    alone->setShortcut(QKeySequence("Ctrl+M"));
    QObject::connect(alone, &QAction::triggered, &window,
                     [&window] { window.views().toggleActiveMaximized(); });
    QAction* const command_line = command_dock.toggleViewAction();
    command_line->setText(localized(L"&Command line", 45024));
    menu.addAction(command_line);
}

} // namespace quarn::desktop
