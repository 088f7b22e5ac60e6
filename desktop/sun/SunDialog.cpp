#include "desktop/sun/SunDialog.h"

#include "desktop/dialogs/DialogOwner.h"
#include "desktop/dialogs/FieldMark.h"
#include "desktop/dialogs/Mnemonics.h"
#include "desktop/texts/Texts.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace quarn::desktop {

SunDialog::SunDialog(const char* name, const QString& title, QWidget* owner)
    : QDialog(topmostOwner(owner)), m_column(new QVBoxLayout(this)), m_rows(new QFormLayout),
      m_flaw(new QLabel(this)) {
    setObjectName(name);
    setWindowTitle(title);
    setWindowModality(Qt::ApplicationModal);
    m_column->setContentsMargins(18, 16, 18, 14);
    m_column->setSpacing(12);
    m_rows->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    m_rows->setHorizontalSpacing(14);
    m_rows->setVerticalSpacing(8);
    m_column->addLayout(m_rows);
    m_flaw->setObjectName("flaw");
    m_flaw->setTextFormat(Qt::PlainText);
    m_flaw->setWordWrap(true);
    QPalette warning = m_flaw->palette();
    warning.setColor(QPalette::WindowText, warningColour(warning));
    m_flaw->setPalette(warning);
    m_flaw->hide();
}

void SunDialog::addRow(const QString& label, QWidget* field, const QList<QWidget*>& beside) {
    auto* const row = new QHBoxLayout;
    row->setSpacing(8);
    row->addWidget(field, 1);
    for (QWidget* const widget : beside)
        row->addWidget(widget);
    if (label.isEmpty()) {
        m_rows->addRow(QString(), row);
        return;
    }
    auto* const text = new QLabel(label, this);
    text->setBuddy(field);
    m_labels << text;
    field->setAccessibleName(label);
    m_rows->addRow(text, row);
}

void SunDialog::check(QWidget* field, std::function<QString()> flaw) {
    m_checks.push_back({field, std::move(flaw)});
}

void SunDialog::forgetFlaws() {
    m_flaw->hide();
    for (const Check& check : m_checks)
        if (auto* const edit = qobject_cast<QLineEdit*>(check.field))
            markField(*edit, {});
}

void SunDialog::finish(const QString& ok) {
    QStringList labels;
    for (const QLabel* const label : m_labels)
        labels << label->text();
    labels = withMnemonics(labels);
    for (qsizetype index = 0; index < labels.size(); ++index)
        m_labels[index]->setText(labels[index]);

    m_column->addWidget(m_flaw);
    auto* const buttons = new QDialogButtonBox(this);
    if (!ok.isEmpty()) {
        QPushButton* const button = buttons->addButton(ok, QDialogButtonBox::AcceptRole);
        button->setObjectName("ok");
        button->setDefault(true);
    }
    const QString leave = ok.isEmpty() ? localized(L"Close", 45521) : localized(L"Cancel", 45301);
    buttons->addButton(leave, QDialogButtonBox::RejectRole)->setObjectName("cancel");
    connect(buttons, &QDialogButtonBox::accepted, this, &SunDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    m_column->addWidget(buttons);
}

void SunDialog::accept() {
    forgetFlaws();
    for (const Check& check : m_checks) {
        const QString flaw = check.flaw();
        if (flaw.isEmpty())
            continue;
        if (auto* const edit = qobject_cast<QLineEdit*>(check.field))
            markField(*edit, flaw);
        m_flaw->setText(flaw);
        m_flaw->show();
        check.field->setFocus(Qt::OtherFocusReason);
        return;
    }
    QDialog::accept();
}

} // namespace quarn::desktop
