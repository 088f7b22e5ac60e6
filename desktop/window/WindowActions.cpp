#include "desktop/window/WindowActions.h"

#include "desktop/animation/AnimationBar.h"
#include "desktop/menus/CommandMenus.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/SizeMenu.h"
#include "desktop/views/ViewArea.h"
#include "desktop/window/MainWindow.h"

#include <QDockWidget>
#include <QToolButton>

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

void addFrameSizeButton(MainWindow& window) {
    auto* const button = new QToolButton(&window);
    auto* const menu = new QMenu(button);
    button->setObjectName("frameSize");
    button->setAutoRaise(true);
    button->setPopupMode(QToolButton::InstantPopup);
    button->setMenu(menu);
    button->setToolTip(localized(L"Size of recorded pictures", 45025));
    ViewArea& views = window.views();
    const auto show_size = [&views, button] { button->setText(sizeText(views.recordedSize())); };
    QObject::connect(menu, &QMenu::aboutToShow, button,
                     [&views, menu] { views.fillRecordedSizes(*menu); });
    QObject::connect(&views, &ViewArea::frameChanged, button, show_size);
    show_size();
    window.animationBar().addControl(button);
}

} // namespace quarn::desktop
