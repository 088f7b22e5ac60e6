#include "vexui/forms/CountField.h"

#include <QKeyEvent>

#include <algorithm>

namespace vexui {

CountField::CountField(int lowest, int highest, QWidget* parent)
    : QSpinBox(parent), m_lowest(lowest) {
    setRange(-highest, highest);
    setAccelerated(true);
}

std::optional<int> CountField::count() const {
    return hasAcceptableInput() ? std::optional(value()) : std::nullopt;
}

void CountField::stepBy(int steps) {
    QSpinBox::stepBy(std::max(steps, m_lowest - value()));
}

void CountField::keyPressEvent(QKeyEvent* event) {
    // The spin box would put back what stood there before, and the form would take that.
    const bool is_enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (is_enter && !hasAcceptableInput())
        event->ignore();
    else
        QSpinBox::keyPressEvent(event);
}

QAbstractSpinBox::StepEnabled CountField::stepEnabled() const {
    StepEnabled enabled = StepNone;
    if (value() > m_lowest)
        enabled |= StepDownEnabled;
    if (value() < maximum())
        enabled |= StepUpEnabled;
    return enabled;
}

} // namespace vexui
