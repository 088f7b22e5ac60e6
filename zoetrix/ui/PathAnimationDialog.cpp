#include "zoetrix/ui/PathAnimationDialog.h"

const CQnRuntimeClass CPathAnimationDialog::ClassRecord = {"CPathAnimationDialog",
                                                           &CQuarnDialog::ClassRecord};

CPathAnimationDialog::CPathAnimationDialog(
    int frame_count, const KM_wString& name, const KM_ClassArray<KM_wString>& file_type_list,
    int file_type_selection, const KM_ClassArray<KM_wString>& capture_list, int capture_selection,
    const KM_ClassArray<KM_wString>& viewport_list, int viewport_selection, CWnd* parent)
    : CAnimationDialog(template_id, file_type_list, file_type_selection, capture_list,
                       capture_selection, viewport_list, viewport_selection, parent),
      m_frame_count(frame_count), m_name(name) {}

CPathAnimationDialog::~CPathAnimationDialog() = default;

const CQnRuntimeClass* CPathAnimationDialog::GetRuntimeClass() const {
    return &ClassRecord;
}

void CPathAnimationDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CAnimationDialog::DoDataExchange(exchange);
    DDX_Text(exchange, frame_count_id, m_frame_count);
    DDX_Text(exchange, name_id, m_name);
}
