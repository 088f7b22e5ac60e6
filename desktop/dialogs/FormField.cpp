#include "desktop/dialogs/FormField.h"

#include "desktop/dialogs/FieldMark.h"
#include "desktop/dialogs/Mnemonics.h"
#include "desktop/texts/PlainTip.h"
#include "desktop/texts/Texts.h"

#include <QComboBox>
#include <QDateEdit>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QRegularExpression>
#include <QTimeEdit>

namespace quarn::desktop {
namespace {

constexpr int NUMBER_WIDTH_LETTERS = 12;
constexpr int TEXT_WIDTH_LETTERS = 26;

int lettersWide(const QWidget& widget, int letters) {
    return widget.fontMetrics().averageCharWidth() * letters;
}

QLineEdit* makeText(QWidget* parent) {
    auto* const field = new QLineEdit(parent);
    field->setMinimumWidth(lettersWide(*field, TEXT_WIDTH_LETTERS));
    return field;
}

/// An empty field is not marked: it is about to be filled.
QLineEdit* makeNumber(QWidget* parent, const char* pattern, const QString& why) {
    auto* const field = new QLineEdit(parent);
    field->setMinimumWidth(lettersWide(*field, NUMBER_WIDTH_LETTERS));
    const QRegularExpression number(QRegularExpression::anchoredPattern(pattern));
    QObject::connect(field, &QLineEdit::textChanged, field, [=](const QString& text) {
        const bool is_one = text.trimmed().isEmpty() || number.match(text).hasMatch();
        markField(*field, is_one ? QString() : why);
    });
    return field;
}

/// The language's own order of day, month and year, with all four digits of the year.
QString dateFormat() {
    QString format = QLocale().dateFormat(QLocale::ShortFormat);
    if (!format.contains("yyyy"))
        format.replace("yy", "yyyy");
    return format;
}

QDateEdit* makeDate(QWidget* parent) {
    auto* const field = new QDateEdit(parent);
    field->setDateRange(QDate(1, 1, 1), QDate(9999, 12, 31));
    field->setDate(QDate::currentDate());
    field->setCalendarPopup(true);
    field->setDisplayFormat(dateFormat());
    return field;
}

/// The language's own order of hours and minutes; some have seconds in it.
QString timeFormat() {
    return QLocale().timeFormat(QLocale::ShortFormat).remove(":ss").remove(".ss");
}

QTimeEdit* makeTime(QWidget* parent) {
    auto* const field = new QTimeEdit(parent);
    field->setDisplayFormat(timeFormat());
    return field;
}

QPushButton* makeButton(const DialogControl& control, QWidget* parent) {
    auto* const button = new QPushButton(qtText(control.label), parent);
    button->setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
    return button;
}

QWidget* makeWidget(const DialogControl& control, QWidget* parent) {
    using Kind = DialogControl::Kind;
    switch (control.kind) {
    case Kind::number:
        return makeNumber(parent, R"(\s*[-+]?(\d+([.,]\d*)?|[.,]\d+)([eE][-+]?\d+)?\s*)",
                          localized(L"Enter a number", 45302));
    case Kind::integer:
        return makeNumber(parent, R"(\s*[-+]?\d+\s*)", localized(L"Enter a whole number", 45303));
    case Kind::date:
        return makeDate(parent);
    case Kind::time:
        return makeTime(parent);
    case Kind::combo_box:
        return new QComboBox(parent);
    case Kind::button:
        return makeButton(control, parent);
    case Kind::text:
        break;
    }
    return makeText(parent);
}

COleDateTime withDate(const QDate& date, const COleDateTime& former) {
    return {date.year(),      date.month(),       date.day(),
            former.GetHour(), former.GetMinute(), former.GetSecond()};
}

/// A time needs some day to be valid.
COleDateTime withTime(const QTime& time, const COleDateTime& former) {
    const COleDateTime day = former.IsValid() ? former : COleDateTime(2000, 1, 1, 0, 0, 0);
    return {day.GetYear(), day.GetMonth(), day.GetDay(), time.hour(), time.minute(), time.second()};
}

/// Seconds that are there must be seen.
void showTime(QTimeEdit& field, const QTime& time) {
    QString format = timeFormat();
    if (time.second() != 0)
        format.replace("mm", "mm:ss");
    field.setDisplayFormat(format);
    field.setTime(time);
}

} // namespace

QWidget* makeField(const DialogControl& control, QWidget* parent) {
    QWidget* const field = makeWidget(control, parent);
    field->setObjectName(QString("control%1").arg(control.id));
    field->setToolTip(plainTip(qtText(control.hint)));
    field->setAccessibleName(withoutMnemonic(qtText(control.label)));
    return field;
}

std::wstring fieldText(const QWidget& field) {
    const auto* const edit = qobject_cast<const QLineEdit*>(&field);
    return edit ? edit->text().toStdWString() : std::wstring();
}

void setFieldText(QWidget& field, std::wstring_view text) {
    if (auto* const edit = qobject_cast<QLineEdit*>(&field))
        edit->setText(qtText(text));
}

COleDateTime fieldDateTime(const QWidget& field, const COleDateTime& former) {
    if (const auto* const date = qobject_cast<const QDateEdit*>(&field))
        return withDate(date->date(), former);
    if (const auto* const time = qobject_cast<const QTimeEdit*>(&field))
        return withTime(time->time(), former);
    return former;
}

void setFieldDateTime(QWidget& field, const COleDateTime& value) {
    if (!value.IsValid())
        return;
    if (auto* const date = qobject_cast<QDateEdit*>(&field))
        date->setDate(QDate(value.GetYear(), value.GetMonth(), value.GetDay()));
    else if (auto* const time = qobject_cast<QTimeEdit*>(&field))
        showTime(*time, QTime(value.GetHour(), value.GetMinute(), value.GetSecond()));
}

void focusField(QWidget& field) {
    field.setFocus(Qt::OtherFocusReason);
    if (auto* const edit = qobject_cast<QLineEdit*>(&field))
        edit->selectAll();
    else if (auto* const spin = qobject_cast<QAbstractSpinBox*>(&field))
        spin->selectAll();
}

} // namespace quarn::desktop
