#pragma once

#include "sdk/qncore/QnExport.h"

#include <memory>

/// A list of a window of which one entry is selected: what a combo box of a dialog shows itself in.
/// Whoever makes windows implements it.
class QNCORE_API IQnComboBoxControl {
public:
    virtual ~IQnComboBoxControl();

    /// Removes all entries.
    virtual void Reset() = 0;
    virtual int Count() const = 0;
    /// Inserts an entry. @param index  from 0 to Count()
    virtual void Insert(int index, const wchar_t* text) = 0;
    /// Selects an entry. @param index  below Count(); -1 for none
    virtual void Select(int index) = 0;
    /// The index of the selected entry; -1 for none.
    virtual int Selection() const = 0;
};

/// A combo box of a dialog. It shows itself in a control, which it owns from the time the dialog's
/// window is made until that window is gone; without one it is empty, and changes do nothing.
class QNCORE_API CComboBox {
public:
    CComboBox();
    ~CComboBox();
    CComboBox(const CComboBox&) = delete;
    CComboBox& operator=(const CComboBox&) = delete;

    /// Takes a control in place of the one it had, which is destroyed. Null: forgets it.
    void SetControl(std::unique_ptr<IQnComboBoxControl> control);
    bool HasControl() const { return m_control != nullptr; }

    /// Removes all entries.
    void ResetContent();
    /// @return the number of entries; 0 without a control
    int GetCount() const;
    /// Inserts an entry. @param index  from 0; -1 inserts behind the last
    /// @return the index of the entry; -1, with nothing changed, for another index, for a null text
    ///         and without a control
    int InsertString(int index, const wchar_t* text);
    /// Selects an entry; with -1, or an index that is not below the number of entries, none.
    /// @return the index that is selected now; -1 for none
    int SetCurSel(int index);
    /// The index of the selected entry; -1 for none and without a control.
    int GetCurSel() const;

private:
    std::unique_ptr<IQnComboBoxControl> m_control;
};
