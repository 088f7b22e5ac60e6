#pragma once

#include "sdk/qncore/QnDialog.h"
#include "zoetrix/ui/DialogList.h"

/// What the plug-in's own forms have in common: the lists of file types, capture methods and
/// viewports. A form stands by itself: whoever shows it hands it the lists, and reads the members
/// after DoModal returned QnDialogConfirmed.
///
/// When the form is filled a selection that is not below the count of its list becomes 0. The
/// viewport selection is measured against the count of the file types instead: with the usual four
/// of them, a viewport behind the fourth is shown as the first one.
class CAnimationDialog : public CQuarnDialog {
public:
    /// Controls that every template has.
    enum list_id : int {
        file_type_id = 6011,
        capture_id = 6012,
        viewport_id = 6013,
    };

    ~CAnimationDialog() override;

    DialogList m_file_type;
    DialogList m_capture;
    DialogList m_viewport;

protected:
    /// @param parent  the window that owns the dialog; may be null
    CAnimationDialog(int template_id, const KM_ClassArray<KM_wString>& file_type_list,
                     int file_type_selection, const KM_ClassArray<KM_wString>& capture_list,
                     int capture_selection, const KM_ClassArray<KM_wString>& viewport_list,
                     int viewport_selection, CWnd* parent);

    /// Fills the lists. @return 1
    int OnInitDialog() override;
    /// Stores what is selected, and closes the form when its fields can be read.
    void OnOK() override;
};
