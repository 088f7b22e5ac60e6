#include "zoetrix/ui/ComboBoxEntries.h"

#include "sdk/qncore/QnComboBox.h"

void InsertEntries(CComboBox& combo_box, const KM_ClassArray<KM_wString>& list) {
    for (int i = 0; i < list.Count(); ++i)
        combo_box.InsertString(i, KM_wString::FormatToString(L"%s", list[i].Array()));
}

void SelectEntry(CComboBox& combo_box, int selection, int count) {
    combo_box.SetCurSel(selection < count ? selection : 0);
}
