#include "vexui/forms/NumberField.h"

#include <QLocale>
#include <QRegularExpression>

#include <algorithm>
#include <cmath>

namespace vexui {

namespace {

constexpr QChar minus_sign(0x2212);

/// Below this a number of degrees is nothing, and its digits would fill the field.
constexpr double smallest = 1e-9;

/// A number as people write it, in the form that every machine reads.
QString plain(const QString& typed) {
    QString text = typed.normalized(QString::NormalizationForm_KC).trimmed();
    text.replace(minus_sign, QLatin1Char('-'));
    text.replace(QLatin1Char(','), QLatin1Char('.'));
    return text;
}

} // namespace

NumberField::NumberField(double lowest, double highest, QWidget* parent)
    : QLineEdit(parent), m_lowest(lowest), m_highest(highest) {
    setMaxLength(40);
}

void NumberField::setNumber(double number) {
    if (!std::isfinite(number) || std::abs(number) < smallest)
        number = 0.0;
    QLocale locale;
    locale.setNumberOptions(QLocale::OmitGroupSeparator);
    setText(locale.toString(std::clamp(number, m_lowest, m_highest), 'f',
                            QLocale::FloatingPointShortest));
}

std::optional<double> NumberField::number() const {
    const QString text = plain(this->text());
    const QRegularExpression number_only(
        QString::fromLatin1("^[+-]?([0-9]+\\.?[0-9]*|\\.[0-9]+)$"));
    if (!number_only.match(text).hasMatch())
        return std::nullopt;
    const double value = text.toDouble();
    if (value < m_lowest || value > m_highest)
        return std::nullopt;
    return value;
}

} // namespace vexui
