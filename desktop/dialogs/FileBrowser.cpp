#include "desktop/dialogs/FileBrowser.h"

#include "desktop/dialogs/MessageBox.h"
#include "desktop/texts/Texts.h"

#include <QDialogButtonBox>
#include <QDir>
#include <QEvent>
#include <QGridLayout>
#include <QGuiApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

namespace quarn::desktop {
namespace {

/// Without a screen there is no desktop.
bool hasDesktop() {
    return QGuiApplication::platformName() != "offscreen" &&
           QGuiApplication::platformName() != "minimal";
}

} // namespace

FileBrowser::FileBrowser(QWidget* owner, const QString& title) : QFileDialog(owner, title) {
    setObjectName("chooser");
    setWindowModality(Qt::ApplicationModal);
    setOption(QFileDialog::DontUseNativeDialog, !hasDesktop());
    setOption(QFileDialog::HideNameFilterDetails); // some kinds have dozens of endings
    setLabelText(QFileDialog::LookIn, localized(L"Folder", 45322));
    setLabelText(QFileDialog::FileName, localized(L"Name", 45323));
    setLabelText(QFileDialog::FileType, localized(L"Kind", 45324));
    setLabelText(QFileDialog::Reject, localized(L"Cancel", 45301));
}

void FileBrowser::askForFolder() {
    setFileMode(QFileDialog::Directory);
    setOption(QFileDialog::ShowDirsOnly);
    setLabelText(QFileDialog::Accept, localized(L"Choose", 45328));
    // There is one kind of folder only, so its row would say nothing.
    for (const char* part : {"fileTypeLabel", "fileTypeCombo"}) {
        if (auto* const widget = findChild<QWidget*>(part))
            widget->hide();
    }
    if (auto* const buttons = findChild<QDialogButtonBox*>("buttonBox"))
        for (QAbstractButton* const button : buttons->buttons())
            if (buttons->buttonRole(button) == QDialogButtonBox::AcceptRole)
                button->installEventFilter(this);
}

/// A folder that is only a name as yet can be chosen, too.
bool FileBrowser::eventFilter(QObject* watched, QEvent* event) {
    auto* const button = qobject_cast<QPushButton*>(watched);
    const auto* const name = findChild<QLineEdit*>("fileNameEdit");
    if (button && event->type() == QEvent::EnabledChange && !button->isEnabled() && name &&
        !name->text().trimmed().isEmpty())
        button->setEnabled(true);
    return QFileDialog::eventFilter(watched, event);
}

void FileBrowser::setMessage(const QString& message) {
    auto* const grid = qobject_cast<QGridLayout*>(layout());
    if (!grid || message.isEmpty())
        return;
    auto* const label = new QLabel(message, this);
    label->setObjectName("message");
    label->setTextFormat(Qt::PlainText);
    label->setWordWrap(true);
    // The grid's own rows move down by one.
    QList<QLayoutItem*> items;
    QList<QRect> cells;
    for (int index = 0; index < grid->count(); ++index) {
        int row = 0, column = 0, rows = 0, columns = 0;
        grid->getItemPosition(index, &row, &column, &rows, &columns);
        cells << QRect(column, row + 1, columns, rows);
    }
    while (grid->count() > 0)
        items << grid->takeAt(0);
    grid->addWidget(label, 0, 0, 1, -1);
    for (qsizetype index = 0; index < items.size(); ++index)
        grid->addItem(items[index], cells[index].top(), cells[index].left(), cells[index].height(),
                      cells[index].width());
}

bool FileBrowser::makeTypedFolder() {
    const QStringList chosen = selectedFiles();
    if (fileMode() != QFileDialog::Directory || chosen.isEmpty() || QDir(chosen.first()).exists())
        return true;
    if (QDir().mkpath(chosen.first()))
        return true;
    showMessageBox(this,
                   localized(L"The folder \"%1\" cannot be made.", 45325)
                       .arg(QDir::toNativeSeparators(chosen.first()))
                       .toStdWString(),
                   windowTitle().toStdWString(), 48);
    return false;
}

void FileBrowser::accept() {
    if (makeTypedFolder())
        QFileDialog::accept();
}

} // namespace quarn::desktop
