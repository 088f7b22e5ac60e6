#include "zoetrix/ui/SeasonDialog.h"

const CQnRuntimeClass CSeasonDialog::ClassRecord = {"CSeasonDialog", &CQuarnDialog::ClassRecord};

CSeasonDialog::CSeasonDialog(double latitude, double longitude, double north_angle,
                             const COleDateTime& start_date, const COleDateTime& end_date,
                             const COleDateTime& time_of_day, const KM_wString& text,
                             const KM_ClassArray<KM_wString>& file_types, int file_type_selection,
                             const KM_ClassArray<KM_wString>& capture_methods,
                             int capture_method_selection,
                             const KM_ClassArray<KM_wString>& viewports, int viewport_selection,
                             int frame_step, CWnd* parent)
    : CSunStudyDialog(template_id, latitude, longitude, north_angle, start_date, end_date,
                      time_of_day, text, file_types, file_type_selection, capture_methods,
                      capture_method_selection, viewports, viewport_selection, frame_step, parent) {
}

CSeasonDialog::~CSeasonDialog() = default;

const CQnRuntimeClass* CSeasonDialog::GetRuntimeClass() const {
    return &ClassRecord;
}
