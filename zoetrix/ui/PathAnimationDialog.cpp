#include "zoetrix/ui/PathAnimationDialog.h"

#include "zoetrix/ui/ComboBoxEntries.h"

const CQnRuntimeClass CPathAnimationDialog::ClassRecord = {"CPathAnimationDialog",
                                                           &CQuarnDialog::ClassRecord};

CPathAnimationDialog::CPathAnimationDialog(
    int frame_count, const KM_wString& name, const KM_ClassArray<KM_wString>& file_type_list,
    int file_type_selection, const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
    const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection, CWnd* parent)
    : CQuarnDialog(template_id, parent), m_frame_count(frame_count),
      m_file_type_list(file_type_list), m_file_type_selection(file_type_selection),
      m_capture_list(capture_list), m_capture_selection(capture_selection),
      m_viewport_list(viewport_list), m_viewport_selection(viewport_selection), m_name(name) {
    AttachComboBox(file_type_id, m_file_type_combo);
    AttachComboBox(capture_id, m_capture_combo);
    AttachComboBox(viewport_id, m_viewport_combo);
}

CPathAnimationDialog::~CPathAnimationDialog() = default;

const CQnRuntimeClass* CPathAnimationDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

void CPathAnimationDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CQuarnDialog::DoDataExchange(exchange);
    DDX_Text(exchange, frame_count_id, m_frame_count);
    DDX_Text(exchange, name_id, m_name);
}

int CPathAnimationDialog::OnInitDialog() {
    CQuarnDialog::OnInitDialog();
    for (CComboBox* combo_box : {&m_file_type_combo, &m_capture_combo, &m_viewport_combo})
        combo_box->ResetContent();
    InsertEntries(m_file_type_combo, m_file_type_list);
    SelectEntry(m_file_type_combo, m_file_type_selection, m_file_type_list.Count());
    InsertEntries(m_capture_combo, m_capture_list);
    SelectEntry(m_capture_combo, m_capture_selection, m_capture_list.Count());
    InsertEntries(m_viewport_combo, m_viewport_list);
    SelectEntry(m_viewport_combo, m_viewport_selection, m_file_type_list.Count());
    return 1;
}

void CPathAnimationDialog::OnOK() {
    m_file_type_selection = m_file_type_combo.GetCurSel();
    m_capture_selection = m_capture_combo.GetCurSel();
    m_viewport_selection = m_viewport_combo.GetCurSel();
    CQuarnDialog::OnOK();
}

void CPathAnimationDialog::OnCancel() {
    CQuarnDialog::OnCancel();
}
