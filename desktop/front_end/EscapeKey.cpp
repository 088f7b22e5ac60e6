#include "desktop/front_end/EscapeKey.h"

#include <QCoreApplication>
#include <QKeyEvent>

#include <utility>

namespace quarn::desktop {

namespace {

bool isEscape(const QEvent& event) {
    return static_cast<const QKeyEvent&>(event).key() == Qt::Key_Escape;
}

} // namespace

EscapeKey::EscapeKey() {
    QCoreApplication::instance()->installEventFilter(this);
}

bool EscapeKey::isDown() {
    return std::exchange(m_was_tapped, false) || m_is_down;
}

void EscapeKey::notePress() {
    m_was_tapped = m_was_tapped || !m_is_down;
    m_is_down = true;
}

/// A press that is somebody's shortcut comes as the question about it alone. A program that is no
/// longer in front is not told when the key goes up.
bool EscapeKey::eventFilter(QObject* watched, QEvent* event) {
    const bool is_press =
        event->type() == QEvent::KeyPress || event->type() == QEvent::ShortcutOverride;
    if (is_press && isEscape(*event))
        notePress();
    else if (event->type() == QEvent::KeyRelease && isEscape(*event) &&
             !static_cast<QKeyEvent*>(event)->isAutoRepeat())
        m_is_down = false;
    else if (event->type() == QEvent::ApplicationDeactivate)
        m_is_down = false;
    return QObject::eventFilter(watched, event);
}

} // namespace quarn::desktop
