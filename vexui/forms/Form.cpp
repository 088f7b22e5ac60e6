#include "vexui/forms/Form.h"

#include "vexui/forms/CountField.h"
#include "vexui/forms/FirstChoices.h"
#include "vexui/texts/LocalText.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QFrame>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyle>
#include <QVBoxLayout>

#include <algorithm>

namespace vexui {

namespace {

constexpr int least_width_px = 460;
constexpr int least_width_of_two_px = 880;
constexpr int icon_size_px = 24;

/// The background of a field that cannot be taken: reddish, and as light or dark as the others.
QPalette markedPalette(QPalette palette) {
    constexpr double share = 0.28;
    const QColor base = palette.color(QPalette::Base);
    const QColor red(224, 49, 49);
    const auto mixed = [](int from, int to) {
        return static_cast<int>(from + (to - from) * share);
    };
    palette.setColor(QPalette::Base,
                     QColor(mixed(base.red(), red.red()), mixed(base.green(), red.green()),
                            mixed(base.blue(), red.blue())));
    return palette;
}

QString withoutMnemonic(QString label) {
    const QString parenthesised = QString::fromLatin1("(&");
    if (const auto at = label.indexOf(parenthesised); at >= 0)
        label.remove(at, 4);
    label.remove(QLatin1Char('&'));
    while (label.endsWith(QLatin1Char(':')) || label.endsWith(QLatin1Char(' ')) ||
           label.endsWith(QChar(0xFF1A)))
        label.chop(1);
    return label;
}

} // namespace

Form::Form(const char* name, const QString& title, QWidget* owner)
    : QDialog(owner), m_columns(new QHBoxLayout(this)), m_column(new QVBoxLayout) {
    setObjectName(QString::fromLatin1(name));
    setWindowTitle(title);
    setMinimumWidth(least_width_px);
    m_columns->setSpacing(16);
    m_columns->setContentsMargins(16, 16, 16, 16);
    m_columns->addLayout(m_column, 1);
    m_column->setSpacing(12);
}

// ---- Fields

void Form::beginColumn() {
    setMinimumWidth(least_width_of_two_px);
    m_column->addStretch(1);
    m_column = new QVBoxLayout;
    m_column->setSpacing(12);
    m_columns->addLayout(m_column, 1);
}

QFormLayout& Form::addSection(const QString& title) {
    auto* group = new QGroupBox(title, this);
    auto* section = new QFormLayout(group);
    section->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    section->setLabelAlignment(Qt::AlignRight | Qt::AlignVCenter);
    section->setHorizontalSpacing(12);
    section->setVerticalSpacing(8);
    section->setContentsMargins(12, 12, 12, 12);
    m_column->addWidget(group);
    return *section;
}

void Form::addField(QFormLayout& section, const Caption& caption, QWidget& field) {
    field.setObjectName(QString::fromLatin1(caption.name));
    field.setToolTip(caption.tip);
    field.setAccessibleName(withoutMnemonic(caption.label));
    auto* label = new QLabel(caption.label, this);
    label->setBuddy(&field);
    label->setToolTip(caption.tip);
    section.addRow(label, &field);
    m_labels.push_back(label);
    addToTabOrder(field);
}

void Form::addCount(QFormLayout& section, const Caption& caption, CountField& field) {
    addField(section, caption, field);
    // The one tells of numbers, the other of what is none.
    connect(&field, &QSpinBox::valueChanged, this, [this] { review(); });
    connect(field.findChild<QLineEdit*>(), &QLineEdit::textChanged, this, [this] { review(); });
}

void Form::addToTabOrder(QWidget& field) {
    m_tab_order.push_back(&field);
}

void Form::check(QWidget& field, Fault fault) {
    m_checks.push_back({&field, std::move(fault), field.toolTip()});
}

QComboBox& Form::addList(QFormLayout& section, const Caption& caption,
                         const KM_ClassArray<KM_wString>& list, int selection) {
    auto* box = new QComboBox(this);
    // A long entry of a document must not make the form wider than the screen.
    box->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    box->setMinimumContentsLength(20);
    for (const KM_wString& entry : list)
        box->addItem(toQt(entry));
    box->setCurrentIndex(selection >= 0 && selection < box->count() ? selection : 0);
    box->setEnabled(box->count() > 0);
    addField(section, caption, *box);
    return *box;
}

RecordingFields Form::addRecording(const IZoetrixDataUI& lists,
                                   const KM_3dmAnimationProperties& record,
                                   BadCharacters bad_characters) {
    QFormLayout& section = addSection(localText(L"Recording", 44011));
    RecordingFields fields;
    fields.file_types =
        &addList(section,
                 {"fileType", localText(L"File &type:", 44022),
                  localText(L"The kind of picture file that every frame is recorded in", 44042)},
                 lists.FileList(), lists.FileListSelection());
    fields.capture_methods = &addList(
        section,
        {"captureMethod", localText(L"&Capture method:", 44023),
         localText(L"What draws the frames: a renderer, or a display mode of the viewport", 44043)},
        lists.CaptureList(), lists.CaptureListSelection());
    fields.viewports =
        &addList(section,
                 {"viewport", localText(L"&Viewport:", 44024),
                  localText(L"The viewport that shows the animation and is recorded", 44044)},
                 lists.ViewportList(), lists.ViewportListSelection());
    offerWhatIsSeen(fields, lists, record);
    fields.name = new QLineEdit(toQt(record.HtmlFilename()), this);
    addField(section,
             {"name", localText(L"&Name:", 44025),
              localText(L"What the recorded pictures and their page are called", 44045)},
             *fields.name);
    connect(fields.name, &QLineEdit::textChanged, this, [this] { review(); });
    check(*fields.name,
          [fields, bad_characters] { return nameFault(fields.nameText(), bad_characters); });
    return fields;
}

void Form::addBeneath(QFormLayout& section, QWidget& widget) {
    section.addRow(QString(), &widget);
}

// ---- The end of the construction

void Form::finish(std::function<Outcome()> outcome) {
    m_column->addStretch(1);
    auto* frame = new QFrame(this);
    auto* row = new QHBoxLayout(frame);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(10);
    m_icon = new QLabel(frame);
    m_icon->setObjectName(QString::fromLatin1("outcomeIcon"));
    m_icon->setFixedSize(icon_size_px, icon_size_px);
    m_line = new QLabel(frame);
    m_line->setObjectName(QString::fromLatin1("outcome"));
    m_line->setTextFormat(Qt::PlainText);
    m_line->setWordWrap(true);
    // Two lines, so that the form does not jump when a longer sentence comes.
    m_line->setMinimumHeight(2 * m_line->fontMetrics().lineSpacing() + 2);
    m_line->setAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    row->addWidget(m_icon);
    row->addWidget(m_line, 1);
    m_column->addWidget(frame);
    addButtons();
    alignLabels();
    for (std::size_t i = 1; i < m_tab_order.size(); ++i)
        QWidget::setTabOrder(m_tab_order[i - 1], m_tab_order[i]);
    m_tab_order.front()->setFocus();
    m_outcome = std::move(outcome);
    review();
}

void Form::addButtons() {
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    QPushButton* confirm = buttons->button(QDialogButtonBox::Ok);
    confirm->setText(localText(L"OK", 44005));
    confirm->setObjectName(QString::fromLatin1("ok"));
    confirm->setToolTip(localText(L"Set up the animation", 44060));
    confirm->setDefault(true);
    QPushButton* cancel = buttons->button(QDialogButtonBox::Cancel);
    cancel->setText(localText(L"Cancel", 44006));
    cancel->setObjectName(QString::fromLatin1("cancel"));
    cancel->setToolTip(localText(L"Close and change nothing", 44061));
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    m_column->addWidget(buttons);
    addToTabOrder(*confirm);
    addToTabOrder(*cancel);
}

/// The fields of all sections begin on one line.
void Form::alignLabels() {
    int width = 0;
    for (const QLabel* label : m_labels)
        width = std::max(width, label->sizeHint().width());
    for (QLabel* label : m_labels)
        label->setMinimumWidth(width);
}

// ---- Checking

void Form::review() {
    if (!m_outcome)
        return;
    QString first_fault;
    m_first_faulty = nullptr;
    for (Check& check : m_checks) {
        const QString fault = check.fault();
        mark(check, fault);
        if (m_first_faulty || fault.isEmpty())
            continue;
        m_first_faulty = check.field;
        first_fault = fault;
    }
    tell(m_first_faulty ? Outcome{first_fault, true} : m_outcome(), m_first_faulty != nullptr);
}

void Form::mark(Check& check, const QString& fault) {
    check.field->setToolTip(fault.isEmpty() ? check.plain_tip : fault);
    check.field->setAccessibleDescription(fault);
    check.field->setPalette(fault.isEmpty() ? QPalette() : markedPalette(palette()));
}

void Form::tell(const Outcome& outcome, bool is_fault) {
    const auto kind = is_fault             ? QStyle::SP_MessageBoxCritical
                      : outcome.is_warning ? QStyle::SP_MessageBoxWarning
                                           : QStyle::SP_MessageBoxInformation;
    m_icon->setPixmap(style()->standardIcon(kind, nullptr, this).pixmap(icon_size_px));
    m_line->setText(outcome.text);
}

void Form::accept() {
    review();
    if (!m_first_faulty) {
        QDialog::accept();
        return;
    }
    m_first_faulty->setFocus(Qt::OtherFocusReason);
    if (auto* line = m_first_faulty->findChild<QLineEdit*>())
        line->selectAll();
    else if (auto* field = qobject_cast<QLineEdit*>(m_first_faulty))
        field->selectAll();
}

} // namespace vexui
