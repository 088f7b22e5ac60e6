#include "zoetrix/ui/SunStudyDialog.h"

#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnLocationDialog.h"

namespace {

/// What the location picker returns for a place that was chosen.
constexpr int chosen = 1;

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
    : CQuarnDialog(template_id, parent), m_latitude(latitude), m_longitude(longitude),
      m_north_angle(north_angle), m_first_date_time(first_date_time),
      m_second_date_time(second_date_time), m_third_date_time(third_date_time), m_text(text),
      m_frame_step(frame_step), m_file_type(file_types, file_type_selection),
      m_capture(capture_methods, capture_method_selection),
      m_viewport(viewports, viewport_selection) {
    AttachComboBox(file_type_id, m_file_type.m_combo);
    AttachComboBox(capture_id, m_capture.m_combo);
    AttachComboBox(viewport_id, m_viewport.m_combo);
}

CSunStudyDialog::~CSunStudyDialog() = default;

void CSunStudyDialog::DoDataExchange(CQnDialogExchange& exchange) {
    CQuarnDialog::DoDataExchange(exchange);
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

int CSunStudyDialog::OnInitDialog() {
    CQuarnDialog::OnInitDialog();
    for (CComboBox* combo_box : {&m_file_type.m_combo, &m_capture.m_combo, &m_viewport.m_combo})
        combo_box->ResetContent();
    m_file_type.Show();
    m_capture.Show();
    m_viewport.Show(m_file_type.m_list.Count());
    return 1;
}

void CSunStudyDialog::OnOK() {
    m_file_type.Store();
    m_capture.Store();
    m_viewport.Store();
    CQuarnDialog::OnOK();
}

void CSunStudyDialog::OnCancel() {
    CQuarnDialog::OnCancel();
}

void CSunStudyDialog::OnButton(int control) {
    if (control == location_button_id)
        OnBnClickedButton1();
}

void CSunStudyDialog::OnBnClickedButton1() {
    double latitude = m_latitude;
    double longitude = m_longitude;
    if (QnShowLocationDialog(QnLocalizeString(L"Set Animation Location", 34509), latitude,
                             longitude) != chosen)
        return;
    m_latitude = latitude;
    m_longitude = longitude;
    SetDlgItemText(latitude_id, degreesText(m_latitude));
    SetDlgItemText(longitude_id, degreesText(m_longitude));
}
