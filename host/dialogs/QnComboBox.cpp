#include "sdk/qncore/QnComboBox.h"

IQnComboBoxControl::~IQnComboBoxControl() = default;

CComboBox::CComboBox() = default;

CComboBox::~CComboBox() = default;

/// The former control is gone before the new one is there, as one window may stand behind both.
void CComboBox::SetControl(std::unique_ptr<IQnComboBoxControl> control) {
    m_control.reset();
    m_control = std::move(control);
}

void CComboBox::ResetContent() {
    if (m_control)
        m_control->Reset();
}

int CComboBox::GetCount() const {
    return m_control ? m_control->Count() : 0;
}

int CComboBox::InsertString(int index, const wchar_t* text) {
    const int count = GetCount();
    const int place = index == -1 ? count : index;
    if (!m_control || !text || place < 0 || place > count)
        return -1;
    m_control->Insert(place, text);
    return place;
}

int CComboBox::SetCurSel(int index) {
    if (!m_control)
        return -1;
    const bool is_entry = index >= 0 && index < m_control->Count();
    m_control->Select(is_entry ? index : -1);
    return m_control->Selection();
}

int CComboBox::GetCurSel() const {
    return m_control ? m_control->Selection() : -1;
}
