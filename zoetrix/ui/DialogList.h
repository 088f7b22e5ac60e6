#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnComboBox.h"

/// A combo box of a form, with the list that it shows and the stored index of an entry.
struct DialogList {
    DialogList(const KM_ClassArray<KM_wString>& list, int selection);

    CComboBox m_combo;
    KM_ClassArray<KM_wString> m_list;
    int m_selection;

    /// Shows the list in the combo box instead of what is there, and selects the stored entry, or
    /// the first one when the stored index is not below `count`.
    ///
    /// @param count  how many entries the index is measured against, which need not be those of the
    ///               list
    void Show(int count);
    /// As above; the index is measured against the list.
    void Show() { Show(m_list.Count()); }

    /// Stores the index that is selected in the combo box; -1 for none.
    void Store() { m_selection = m_combo.GetCurSel(); }
};
