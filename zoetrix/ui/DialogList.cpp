#include "zoetrix/ui/DialogList.h"

DialogList::DialogList(const KM_ClassArray<KM_wString>& list, int selection)
    : m_list(list), m_selection(selection) {}

void DialogList::Show(int count) {
    m_combo.ResetContent();
    for (int i = 0; i < m_list.Count(); ++i)
        m_combo.InsertString(i, KM_wString::FormatToString(L"%s", m_list[i].Array()));
    m_combo.SetCurSel(m_selection < count ? m_selection : 0);
}
