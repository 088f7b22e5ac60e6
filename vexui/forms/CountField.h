#pragma once

#include <QSpinBox>

#include <optional>

namespace vexui {

/// A field for a whole number. One that is too small can be typed, so that the form can say why it
/// is not taken; the arrows stop at the least.
class CountField final : public QSpinBox {
public:
    CountField(int lowest, int highest, QWidget* parent);

    /// The number that stands there; nothing while no number does.
    std::optional<int> count() const;

    void stepBy(int steps) override;

protected:
    void keyPressEvent(QKeyEvent* event) override;
    StepEnabled stepEnabled() const override;

private:
    int m_lowest;
};

} // namespace vexui
