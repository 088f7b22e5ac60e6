#include "zoetrix/ui/ComboBoxList.h"

ComboBoxList::ComboBoxList(const KM_ClassArray<KM_wString>& list, int selection)
    : m_list(list), m_selection(selection) {}

void ComboBoxList::Show(int count) {
    for (int i = 0; i < m_list.Count(); ++i)
        m_combo.InsertString(i, KM_wString::FormatToString(L"%s", m_list[i].Array()));
    m_combo.SetCurSel(m_selection < count ? m_selection : 0);
}
