#include "desktop/recovery/RecoveryDialog.h"

#include "desktop/dialogs/MessageBox.h"
#include "desktop/recovery/RecoveryRow.h"
#include "desktop/texts/Texts.h"

#include <QDateTime>
#include <QDialogButtonBox>
#include <QDir>
#include <QLabel>
#include <QListWidget>
#include <QLocale>
#include <QPushButton>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

constexpr QSize FIRST_SIZE{560, 420};

QImage pictureOf(const RecoverableDocument& document) {
    const auto* const bytes = reinterpret_cast<const uchar*>(document.picture.data());
    return QImage::fromData(bytes, static_cast<int>(document.picture.size()), "PNG");
}

/// Its folder, from the person's own on.
QString placeOf(const RecoverableDocument& document) {
    if (document.document.empty())
        return localized(L"Never saved to a file", 45399);
    const QString folder = qtText(document.document.parent_path());
    const QString home = QDir::homePath();
    const bool is_at_home = folder == home || folder.startsWith(home + '/');
    return is_at_home ? '~' + folder.mid(home.size()) : folder;
}

QString timeOf(const RecoverableDocument& document) {
    const qint64 since_epoch_ms =
        std::chrono::duration_cast<std::chrono::milliseconds>(document.kept_at.time_since_epoch())
            .count();
    const QDateTime kept_at = QDateTime::fromMSecsSinceEpoch(since_epoch_ms);
    const QLocale locale;
    return localized(L"Kept on %1 at %2", 45400)
        .arg(locale.toString(kept_at.date(), QLocale::LongFormat),
             locale.toString(kept_at.time(), QLocale::ShortFormat));
}

} // namespace

QString nameOf(const RecoverableDocument& document) {
    return document.document.empty() ? localized(L"New document", 45022)
                                     : qtText(document.document.filename());
}

RecoveryDialog::RecoveryDialog(std::vector<RecoverableDocument> documents, RecoveryActs acts,
                               QWidget* owner)
    : QDialog(owner), m_documents(std::move(documents)), m_acts(std::move(acts)),
      m_list(new QListWidget(this)) {
    setObjectName("recovery");
    setWindowTitle(localized(L"Recover unsaved work", 45390));
    setWindowModality(Qt::ApplicationModal);
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(18, 18, 18, 14);
    column->setSpacing(12);
    auto* const words =
        new QLabel(localized(L"The program ended before these documents were saved.", 45392), this);
    words->setWordWrap(true);
    column->addWidget(words);
    m_list->setObjectName("recoverable");
    m_list->setAccessibleName(localized(L"Documents that can be recovered", 45403));
    m_list->setItemDelegate(new RecoveryRow(m_list));
    m_list->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    m_list->setUniformItemSizes(true);
    for (std::size_t index = 0; index < m_documents.size(); ++index)
        addDocument(m_documents[index], index);
    m_list->setCurrentRow(0);
    column->addWidget(m_list, 1);
    addButtons(*column);
    connect(m_list, &QListWidget::itemDoubleClicked, this, &RecoveryDialog::recoverChosen);
    m_list->setFocus();
    resize(FIRST_SIZE);
}

void RecoveryDialog::addDocument(const RecoverableDocument& document, std::size_t index) {
    auto* const row = new QListWidgetItem(m_list);
    const QString name = nameOf(document);
    const QString place = placeOf(document);
    QString time = timeOf(document);
    if (fileIsNewer(document))
        time += '\n' + localized(L"Older than its file, which was saved later", 45406);
    row->setText(name);
    row->setData(RecoveryRow::PLACE, place);
    row->setData(RecoveryRow::TIME, time);
    row->setData(RecoveryRow::PICTURE, pictureOf(document));
    row->setData(Qt::AccessibleTextRole,
                 QStringList{name, place, time}.join(", ").replace('\n', ", "));
    row->setData(Qt::UserRole, static_cast<qulonglong>(index));
    row->setToolTip(qtText(document.document));
}

void RecoveryDialog::addButtons(QLayout& column) {
    auto* const buttons = new QDialogButtonBox(this);
    QPushButton* const recover =
        buttons->addButton(localized(L"&Recover", 45393), QDialogButtonBox::AcceptRole);
    QPushButton* const discard =
        buttons->addButton(localized(L"&Discard…", 45394), QDialogButtonBox::DestructiveRole);
    QPushButton* const later =
        buttons->addButton(localized(L"&Later", 45395), QDialogButtonBox::RejectRole);
    recover->setObjectName("recover");
    discard->setObjectName("discard");
    later->setObjectName("later");
    later->setToolTip(localized(L"Asks again at the next start", 45397));
    recover->setDefault(true);
    connect(recover, &QPushButton::clicked, this, &RecoveryDialog::recoverChosen);
    connect(discard, &QPushButton::clicked, this, &RecoveryDialog::discardChosen);
    connect(later, &QPushButton::clicked, this, &QDialog::reject);
    column.addWidget(buttons);
}

const RecoverableDocument& RecoveryDialog::chosen() const {
    return m_documents[m_list->currentItem()->data(Qt::UserRole).toULongLong()];
}

/// What cannot be opened stays in the list: it may be discarded, or tried again another day.
void RecoveryDialog::recoverChosen() {
    const std::optional<std::string> trouble = m_acts.recover(chosen());
    if (!trouble) {
        accept();
        return;
    }
    showMessageBox(this, KM_wString::FromUtf8(*trouble).View(), windowTitle().toStdWString(), 0x30);
}

void RecoveryDialog::discardChosen() {
    const QString question =
        localized(L"Discard the unsaved work of %1? It cannot be brought back.", 45396)
            .arg(nameOf(chosen()));
    if (!askWhether(this, question.toStdWString(), windowTitle().toStdWString(),
                    localized(L"Discard", 45398).toStdWString()))
        return;
    m_acts.discard(chosen());
    delete m_list->takeItem(m_list->currentRow());
    if (m_list->count() == 0)
        reject();
}

} // namespace quarn::desktop
