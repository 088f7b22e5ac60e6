#pragma once

#include <QObject>

namespace quarn::desktop {

/// Whether the Escape key is down, whatever part of the window has the keyboard. A short tap
/// between two looks is seen once.
class EscapeKey : public QObject {
public:
    /// Watches the application's events for as long as it lives.
    EscapeKey();

    /// Whether the key is down, or was pressed since the last look.
    bool isDown();
    /// Forgets a tap that was not looked at: it meant something else.
    void forgetTap() { m_was_tapped = false; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void notePress();

    bool m_is_down = false;
    bool m_was_tapped = false;
};

} // namespace quarn::desktop
