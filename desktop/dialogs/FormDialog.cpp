#include "desktop/dialogs/FormDialog.h"

#include "desktop/dialogs/FormField.h"
#include "desktop/dialogs/Mnemonics.h"
#include "desktop/texts/PlainTip.h"
#include "desktop/texts/Texts.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace quarn::desktop {
namespace {

QStringList labelsOf(const DialogTemplate& form) {
    QStringList labels;
    for (const DialogControl& control : form.controls)
        labels << qtText(control.label);
    return withMnemonics(labels);
}

QLabel* makeLabel(const QString& text, const DialogControl& control, QWidget* field) {
    auto* const label = new QLabel(text, field->parentWidget());
    label->setTextFormat(Qt::PlainText);
    label->setBuddy(field);
    label->setToolTip(plainTip(qtText(control.hint)));
    return label;
}

} // namespace

FormDialog::FormDialog(const DialogTemplate& form, QWidget* owner) : QDialog(owner) {
    setObjectName(QString("form%1").arg(form.id));
    setWindowTitle(qtText(form.title));
    setWindowModality(Qt::ApplicationModal);
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(18, 18, 18, 14);
    column->setSpacing(16);
    auto* const rows = new QFormLayout;
    rows->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    rows->setHorizontalSpacing(14);
    rows->setVerticalSpacing(9);
    column->addLayout(rows);
    const QStringList labels = labelsOf(form);
    for (std::size_t index = 0; index < form.controls.size(); ++index)
        addControl(form.controls[index], labels[static_cast<qsizetype>(index)], *rows);
    column->addStretch(1);
    addButtons(*column);
}

void FormDialog::addControl(const DialogControl& control, const QString& label, QFormLayout& rows) {
    QWidget* const field = makeField(control, this);
    const bool is_button = control.kind == DialogControl::Kind::button;
    if (auto* const button = qobject_cast<QPushButton*>(field)) {
        button->setText(label);
        connect(button, &QPushButton::clicked, this, [this, id = control.id] {
            if (m_events)
                m_events->buttonClicked(id);
        });
    }
    QLabel* const text = is_button || label.isEmpty() ? nullptr : makeLabel(label, control, field);
    if (control.joins_row && m_row) {
        if (text)
            m_row->addWidget(text);
    } else {
        m_row = new QHBoxLayout;
        m_row->setSpacing(8);
        rows.addRow(text, m_row);
    }
    m_row->addWidget(field, is_button ? 0 : 1, is_button ? Qt::AlignLeft : Qt::Alignment());
    if (m_last)
        setTabOrder(m_last, field);
    m_last = field;
    m_fields.emplace(control.id, field);
}

void FormDialog::addButtons(QLayout& column) {
    auto* const buttons = new QDialogButtonBox(this);
    QPushButton* const ok =
        buttons->addButton(localized(L"OK", 45300), QDialogButtonBox::AcceptRole);
    QPushButton* const cancel =
        buttons->addButton(localized(L"Cancel", 45301), QDialogButtonBox::RejectRole);
    ok->setObjectName("ok");
    ok->setDefault(true);
    cancel->setObjectName("cancel");
    connect(buttons, &QDialogButtonBox::accepted, this, &FormDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &FormDialog::reject);
    column.addWidget(buttons);
}

void FormDialog::open(DialogEvents& events) {
    m_events = &events;
    show();
    raise();
    activateWindow();
}

void FormDialog::leave() {
    m_events = nullptr;
    hide();
}

QWidget* FormDialog::field(int control) const {
    const auto found = m_fields.find(control);
    return found == m_fields.end() ? nullptr : found->second;
}

void FormDialog::accept() {
    if (m_events)
        m_events->confirmed();
}

void FormDialog::reject() {
    if (m_events)
        m_events->givenUp();
}

} // namespace quarn::desktop
