#include "zoetrix/ui/TurnTableDialog.h"

const CQnRuntimeClass CTurnTableDialog::ClassRecord = {"CTurnTableDialog",
                                                       &CQuarnDialog::ClassRecord};

CTurnTableDialog::CTurnTableDialog(
    int frame_count, const KM_wString& name, const KM_ClassArray<KM_wString>& direction_list,
    int direction_selection, const KM_ClassArray<KM_wString>& file_type_list,
    int file_type_selection, const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
    const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection, CWnd* parent)
    : CAnimationDialog(template_id, file_type_list, file_type_selection, capture_list,
                       capture_selection, viewport_list, viewport_selection, parent),
      m_frame_count(frame_count), m_direction(direction_list, direction_selection), m_name(name) {
    AttachComboBox(direction_id, m_direction.m_combo);
}

CTurnTableDialog::~CTurnTableDialog() = default;

const CQnRuntimeClass* CTurnTableDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

const wchar_t* CTurnTableDialog::ControllerName() const {
    return L"QXTurnTableDialogController";
}

void CTurnTableDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CAnimationDialog::DoDataExchange(exchange);
    DDX_Text(exchange, frame_count_id, m_frame_count);
    DDX_Text(exchange, name_id, m_name);
}

int CTurnTableDialog::OnInitDialog() {
    CAnimationDialog::OnInitDialog();
    m_direction.Show();
    return 1;
}

void CTurnTableDialog::OnOK() {
    m_direction.Store();
    CAnimationDialog::OnOK();
}
