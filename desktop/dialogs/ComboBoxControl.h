#pragma once

#include "sdk/qncore/QnComboBox.h"

#include <QComboBox>
#include <QPointer>

namespace quarn::desktop {

/// The list of a combo box. Once the combo box is gone it is empty, and changes do nothing.
class ComboBoxControl final : public IQnComboBoxControl {
public:
    explicit ComboBoxControl(QComboBox* box) : m_box(box) {}

    void Reset() override;
    int Count() const override;
    void Insert(int index, const wchar_t* text) override;
    void Select(int index) override;
    int Selection() const override;

private:
    QPointer<QComboBox> m_box;
};

} // namespace quarn::desktop
