#include "zoetrix/ui/TurnTableDialog.h"

const CQnRuntimeClass CTurnTableDialog::ClassRecord = {"CTurnTableDialog",
                                                       &CQuarnDialog::ClassRecord};

CTurnTableDialog::CTurnTableDialog(
    int frame_count, const KM_wString& name, const KM_ClassArray<KM_wString>& direction_list,
    int direction_selection, const KM_ClassArray<KM_wString>& file_type_list,
    int file_type_selection, const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
    const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection, CWnd* parent)
    : CQuarnDialog(template_id, parent), m_frame_count(frame_count),
      m_direction(direction_list, direction_selection),
      m_file_type(file_type_list, file_type_selection), m_capture(capture_list, capture_selection),
      m_viewport(viewport_list, viewport_selection), m_name(name) {
    AttachComboBox(direction_id, m_direction.m_combo);
    AttachComboBox(file_type_id, m_file_type.m_combo);
    AttachComboBox(capture_id, m_capture.m_combo);
    AttachComboBox(viewport_id, m_viewport.m_combo);
}

CTurnTableDialog::~CTurnTableDialog() = default;

const CQnRuntimeClass* CTurnTableDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

const wchar_t* CTurnTableDialog::ControllerName() const {
    return L"QXTurnTableDialogController";
}

void CTurnTableDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CQuarnDialog::DoDataExchange(exchange);
    DDX_Text(exchange, frame_count_id, m_frame_count);
    DDX_Text(exchange, name_id, m_name);
}

int CTurnTableDialog::OnInitDialog() {
    CQuarnDialog::OnInitDialog();
    for (CComboBox* combo_box :
         {&m_direction.m_combo, &m_file_type.m_combo, &m_capture.m_combo, &m_viewport.m_combo})
        combo_box->ResetContent();
    m_direction.Show();
    m_file_type.Show();
    m_capture.Show();
    m_viewport.Show(m_file_type.m_list.Count());
    return 1;
}

void CTurnTableDialog::OnOK() {
    m_direction.Store();
    m_file_type.Store();
    m_capture.Store();
    m_viewport.Store();
    CQuarnDialog::OnOK();
}

void CTurnTableDialog::OnCancel() {
    CQuarnDialog::OnCancel();
}
