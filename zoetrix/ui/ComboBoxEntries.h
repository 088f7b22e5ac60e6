#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"

class CComboBox;

/// Inserts every text of a list at its index. The combo box must be empty.
void InsertEntries(CComboBox& combo_box, const KM_ClassArray<KM_wString>& list);

/// Selects a stored entry, or the first one when the stored index is not below `count`.
///
/// @param count  how many entries the index is measured against, which need not be those of the
///               combo box
void SelectEntry(CComboBox& combo_box, int selection, int count);
