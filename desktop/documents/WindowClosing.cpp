#include "desktop/documents/WindowClosing.h"

#include "desktop/command_line/CommandPane.h"
#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/texts/Texts.h"

#include <QMessageBox>
#include <QPushButton>
#include <QTimer>

namespace quarn::desktop {

WindowClosing::WindowClosing(CommandStarter& starter, CommandPane& pane, UnsavedChanges& changes,
                             QWidget& window)
    : QObject(&window), m_starter(starter), m_pane(pane), m_changes(changes), m_window(window) {
    connect(&starter, &CommandStarter::ended, this, &WindowClosing::commandEnded);
}

bool WindowClosing::mayClose() {
    if (!mayStop())
        return false;
    if (!m_starter.isRunning()) // it may have ended while the person thought about it
        return m_changes.mayLeave();
    m_closes_afterwards = true;
    m_starter.stop();
    m_pane.cancelQuestion();
    return false;
}

bool WindowClosing::mayStop() {
    return !m_starter.isRunning() || m_pane.isAsking() || askToStop();
}

bool WindowClosing::askToStop() {
    const QString name = m_starter.line().section(' ', 0, 0);
    QMessageBox box(QMessageBox::Question, localized(L"A command is running", 45256),
                    localized(L"%1 has not finished.", 45257).arg(name), QMessageBox::NoButton,
                    &m_window);
    box.setObjectName("commandRuns");
    box.setTextFormat(Qt::PlainText);
    QPushButton* const stop =
        box.addButton(localized(L"&Stop it and close", 45258), QMessageBox::AcceptRole);
    QPushButton* const go_on =
        box.addButton(localized(L"&Let it go on", 45259), QMessageBox::RejectRole);
    stop->setObjectName("stopAndClose");
    go_on->setObjectName("letGoOn");
    box.setDefaultButton(go_on);
    box.setEscapeButton(go_on);
    box.exec();
    return box.clickedButton() == stop;
}

/// The command is still on the stack; the window may not go before it has returned.
void WindowClosing::commandEnded() {
    if (!m_closes_afterwards)
        return;
    m_closes_afterwards = false;
    QTimer::singleShot(0, &m_window, &QWidget::close);
}

} // namespace quarn::desktop
