#pragma once

#include "zoetrix/ui/AnimationDialog.h"

/// The plug-in's own form of a turntable animation: frame count, direction, file type, capture
/// method, viewport and name.
class CTurnTableDialog : public CAnimationDialog {
public:
    static const CQnRuntimeClass ClassRecord;

    /// Controls of the template.
    enum control_id : int {
        template_id = 6004,
        frame_count_id = 6005,
        name_id = 6009,
        direction_id = 6014,
    };

    /// @param frame_count  frames of the animation
    /// @param name         of the animation
    /// @param parent       the window that owns the dialog; may be null
    CTurnTableDialog(int frame_count, const KM_wString& name,
                     const KM_ClassArray<KM_wString>& direction_list, int direction_selection,
                     const KM_ClassArray<KM_wString>& file_type_list, int file_type_selection,
                     const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
                     const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection,
                     CWnd* parent);
    ~CTurnTableDialog() override;

    const CQnRuntimeClass* GetRuntimeClass() const override;
    /// "QXTurnTableDialogController".
    const wchar_t* ControllerName() const override;

    int m_frame_count;
    DialogList m_direction;
    KM_wString m_name;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    int OnInitDialog() override;
    void OnOK() override;
};
