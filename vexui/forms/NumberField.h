#pragma once

#include <QLineEdit>

#include <optional>

namespace vexui {

/// A field for a number that need not be whole. It shows the user's decimal sign and takes both
/// point and comma; thousands are not grouped.
class NumberField final : public QLineEdit {
public:
    NumberField(double lowest, double highest, QWidget* parent);

    /// Shows a number, to the nearest within the limits; one that is none is shown as 0.
    void setNumber(double number);

    /// The number that stands there; nothing unless it is one within the limits.
    std::optional<double> number() const;

private:
    double m_lowest;
    double m_highest;
};

} // namespace vexui
