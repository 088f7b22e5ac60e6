#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnDialog.h"
#include "zoetrix/ui/ComboBoxList.h"

/// The plug-in's own form of an animation along a path: frame count, file type, capture method,
/// viewport and name. It stands by itself: whoever shows it hands it the lists, and reads the
/// members after DoModal returned 1.
///
/// When the form is filled a selection that is not below the count of its list becomes 0. The
/// viewport selection is measured against the count of the file types, and stored choices depend on
/// that.
class CPathAnimationDialog : public CQuarnDialog {
public:
    static const CQnRuntimeClass ClassRecord;

    /// Controls of the template.
    enum control_id : int {
        template_id = 6005,
        frame_count_id = 6005,
        name_id = 6009,
        file_type_id = 6011,
        capture_id = 6012,
        viewport_id = 6013,
    };

    /// @param frame_count  frames of the animation
    /// @param name         of the animation
    /// @param parent       the window that owns the dialog; may be null
    CPathAnimationDialog(int frame_count, const KM_wString& name,
                         const KM_ClassArray<KM_wString>& file_type_list, int file_type_selection,
                         const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
                         const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection,
                         CWnd* parent);
    ~CPathAnimationDialog() override;

    const CQnRuntimeClass* GetRuntimeClass() const override;

    int m_frame_count;
    ComboBoxList m_file_type;
    ComboBoxList m_capture;
    ComboBoxList m_viewport;
    KM_wString m_name;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    int OnInitDialog() override;
    void OnOK() override;
    void OnCancel() override;
};
