#include "zoetrix/ui/AnimationDialog.h"

CAnimationDialog::CAnimationDialog(int template_id, const KM_ClassArray<KM_wString>& file_type_list,
                                   int file_type_selection,
                                   const KM_ClassArray<KM_wString>& capture_list,
                                   int capture_selection,
                                   const KM_ClassArray<KM_wString>& viewport_list,
                                   int viewport_selection, CWnd* parent)
    : CQuarnDialog(template_id, parent), m_file_type(file_type_list, file_type_selection),
      m_capture(capture_list, capture_selection), m_viewport(viewport_list, viewport_selection) {
    AttachComboBox(file_type_id, m_file_type.m_combo);
    AttachComboBox(capture_id, m_capture.m_combo);
    AttachComboBox(viewport_id, m_viewport.m_combo);
}

CAnimationDialog::~CAnimationDialog() = default;

int CAnimationDialog::OnInitDialog() {
    CQuarnDialog::OnInitDialog();
    m_file_type.Show();
    m_capture.Show();
    m_viewport.Show(m_file_type.m_list.Count());
    return 1;
}

void CAnimationDialog::OnOK() {
    m_file_type.Store();
    m_capture.Store();
    m_viewport.Store();
    CQuarnDialog::OnOK();
}
