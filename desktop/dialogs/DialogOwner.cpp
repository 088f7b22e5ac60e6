#include "desktop/dialogs/DialogOwner.h"

#include <QApplication>

namespace quarn::desktop {

QWidget* topmostOwner(QWidget* wanted) {
    QWidget* const open = QApplication::activeModalWidget();
    return open ? open : wanted;
}

} // namespace quarn::desktop
