#include "zoetrix/ui/SunDialog.h"

const CQnRuntimeClass CSunDialog::ClassRecord = {"CSunDialog", &CQuarnDialog::ClassRecord};

CSunDialog::CSunDialog(double latitude, double longitude, double north_angle,
                       const COleDateTime& day, const COleDateTime& start_time,
                       const COleDateTime& end_time, const KM_wString& text,
                       const KM_ClassArray<KM_wString>& file_types, int file_type_selection,
                       const KM_ClassArray<KM_wString>& capture_methods,
                       int capture_method_selection, const KM_ClassArray<KM_wString>& viewports,
                       int viewport_selection, int frame_step, CWnd* parent)
    : CSunStudyDialog(template_id, latitude, longitude, north_angle, day, start_time, end_time,
                      text, file_types, file_type_selection, capture_methods,
                      capture_method_selection, viewports, viewport_selection, frame_step, parent) {
}

CSunDialog::~CSunDialog() = default;

const CQnRuntimeClass* CSunDialog::GetRuntimeClass() const {
    return &ClassRecord;
}
