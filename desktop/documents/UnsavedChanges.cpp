#include "desktop/documents/UnsavedChanges.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/texts/Texts.h"
#include "host/session/DocumentState.h"

#include <QMessageBox>
#include <QPushButton>

namespace quarn::desktop {

namespace {

bool leavesDocument(const QString& english_name) {
    return english_name == "New" || english_name == "Open" || english_name == "Recover" ||
           english_name == "Exit";
}

QString nameOf(CQuarnDoc& document) {
    const std::filesystem::path file = documentFile(document);
    return file.empty() ? localized(L"the new document", 45250) : qtText(file.filename());
}

} // namespace

UnsavedChanges::UnsavedChanges(Session& session, CommandStarter& starter, QWidget& window)
    : QObject(&window), m_session(session), m_starter(starter), m_window(window) {}

bool UnsavedChanges::mayLeave() {
    const bool was_settled = m_may_exit && m_session.isExitRequested();
    if (was_settled || !isModified(m_session.document()))
        return true;
    const Choice choice = askPerson();
    const bool leaves = choice == Choice::discard || (choice == Choice::save && save());
    if (!leaves)
        m_session.takeBackExit(); // or the end of the next command would ask again
    return leaves;
}

void UnsavedChanges::start(const QString& line) {
    const QString name = readLine(m_session, line).english_name;
    if (!m_starter.isRunning() && leavesDocument(name)) {
        if (!mayLeave())
            return;
        m_may_exit = name == "Exit";
    }
    m_starter.start(line);
}

UnsavedChanges::Choice UnsavedChanges::askPerson() {
    QMessageBox box(QMessageBox::Warning, localized(L"Unsaved changes", 45251),
                    localized(L"Save the changes to %1?", 45252).arg(nameOf(m_session.document())),
                    QMessageBox::NoButton, &m_window);
    box.setObjectName("unsavedChanges");
    box.setTextFormat(Qt::PlainText);
    box.setInformativeText(localized(L"Without saving they are lost.", 45253));
    QPushButton* const save = box.addButton(localized(L"&Save", 45254), QMessageBox::AcceptRole);
    QPushButton* const discard =
        box.addButton(localized(L"&Don't save", 45255), QMessageBox::DestructiveRole);
    QPushButton* const stay = box.addButton(localized(L"Cancel", 45105), QMessageBox::RejectRole);
    save->setObjectName("saveChanges");
    discard->setObjectName("discardChanges");
    stay->setObjectName("keepDocument");
    box.setDefaultButton(save);
    box.setEscapeButton(stay);
    box.exec();
    if (box.clickedButton() == save)
        return Choice::save;
    return box.clickedButton() == discard ? Choice::discard : Choice::stay;
}

/// A new document's file is asked for by the command; who gives up there stays.
bool UnsavedChanges::save() {
    m_starter.start("_Save");
    return !isModified(m_session.document());
}

} // namespace quarn::desktop
