#include "desktop/dialogs/MessageBox.h"

#include "desktop/dialogs/DialogOwner.h"
#include "desktop/texts/Texts.h"

#include <QMessageBox>
#include <QPointer>
#include <QPushButton>

namespace quarn::desktop {
namespace {

QMessageBox::Icon iconOf(unsigned flags) {
    switch (flags & 0xF0U) {
    case 0x10:
        return QMessageBox::Critical;
    case 0x20:
        return QMessageBox::Question;
    case 0x30:
        return QMessageBox::Warning;
    case 0x40:
        return QMessageBox::Information;
    default:
        return QMessageBox::NoIcon;
    }
}

/// The text is never taken for markup: names from documents stand in it.
QMessageBox* makeBox(QWidget* owner, std::wstring_view text, std::wstring_view title) {
    auto* const box = new QMessageBox(topmostOwner(owner));
    box->setObjectName("message");
    box->setTextFormat(Qt::PlainText);
    box->setTextInteractionFlags(Qt::TextSelectableByMouse);
    box->setWindowTitle(qtText(title));
    box->setText(qtText(text));
    box->setWindowModality(Qt::ApplicationModal);
    return box;
}

} // namespace

int showMessageBox(QWidget* owner, std::wstring_view text, std::wstring_view title,
                   unsigned flags) {
    const QPointer<QMessageBox> box = makeBox(owner, text, title);
    box->setIcon(iconOf(flags));
    QPushButton* const ok = box->addButton(localized(L"OK", 45300), QMessageBox::AcceptRole);
    ok->setObjectName("ok");
    box->setDefaultButton(ok);
    box->setEscapeButton(ok);
    box->exec();
    delete box.data();
    return 1;
}

bool askWhether(QWidget* owner, std::wstring_view text, std::wstring_view title,
                std::wstring_view yes) {
    const QPointer<QMessageBox> box = makeBox(owner, text, title);
    box->setIcon(QMessageBox::Question);
    QPushButton* const agree = box->addButton(qtText(yes), QMessageBox::AcceptRole);
    QPushButton* const cancel =
        box->addButton(localized(L"Cancel", 45301), QMessageBox::RejectRole);
    agree->setObjectName("yes");
    cancel->setObjectName("cancel");
    box->setDefaultButton(cancel);
    box->setEscapeButton(cancel);
    box->exec();
    const bool agreed = box && box->clickedButton() == agree;
    delete box.data();
    return agreed;
}

} // namespace quarn::desktop
