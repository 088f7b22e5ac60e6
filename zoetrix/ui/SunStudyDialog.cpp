#include "zoetrix/ui/SunStudyDialog.h"

#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnLocationDialog.h"

namespace {

KM_wString degreesText(double degrees) {
    return KM_wString::FormatToString(L"%.2f", degrees);
}

} // namespace

CSunStudyDialog::CSunStudyDialog(int template_id, double latitude, double longitude,
                                 double north_angle, const COleDateTime& first_date_time,
                                 const COleDateTime& second_date_time,
                                 const COleDateTime& third_date_time, const KM_wString& text,
                                 const KM_ClassArray<KM_wString>& file_types,
                                 int file_type_selection,
                                 const KM_ClassArray<KM_wString>& capture_methods,
                                 int capture_method_selection,
                                 const KM_ClassArray<KM_wString>& viewports, int viewport_selection,
                                 int frame_step, CWnd* parent)
    : CAnimationDialog(template_id, file_types, file_type_selection, capture_methods,
                       capture_method_selection, viewports, viewport_selection, parent),
      m_latitude(latitude), m_longitude(longitude), m_north_angle(north_angle),
      m_first_date_time(first_date_time), m_second_date_time(second_date_time),
      m_third_date_time(third_date_time), m_text(text), m_frame_step(frame_step) {}

CSunStudyDialog::~CSunStudyDialog() = default;

void CSunStudyDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CAnimationDialog::DoDataExchange(exchange);
    DDX_Text(exchange, latitude_id, m_latitude);
    DDV_MinMaxDouble(exchange, m_latitude, -90.0, 90.0);
    DDX_Text(exchange, longitude_id, m_longitude);
    DDV_MinMaxDouble(exchange, m_longitude, -180.0, 180.0);
    DDX_Text(exchange, north_angle_id, m_north_angle);
    DDV_MinMaxDouble(exchange, m_north_angle, 0.0, 360.0);
    DDX_Text(exchange, text_id, m_text);
    DDX_DateTimeCtrl(exchange, first_date_time_id, m_first_date_time);
    DDX_DateTimeCtrl(exchange, second_date_time_id, m_second_date_time);
    DDX_DateTimeCtrl(exchange, third_date_time_id, m_third_date_time);
    DDX_Text(exchange, frame_step_id, m_frame_step);
}

void CSunStudyDialog::OnButton(int control) {
    if (control == location_button_id)
        OnBnClickedButton1();
}

void CSunStudyDialog::OnBnClickedButton1() {
    double latitude = m_latitude;
    double longitude = m_longitude;
    if (QnShowLocationDialog(QnLocalizeString(L"Set Animation Location", 34509), latitude,
                             longitude) != QnDialogConfirmed)
        return;
    m_latitude = latitude;
    m_longitude = longitude;
    SetDlgItemText(latitude_id, degreesText(m_latitude));
    SetDlgItemText(longitude_id, degreesText(m_longitude));
}
