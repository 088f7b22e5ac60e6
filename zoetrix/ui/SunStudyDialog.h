#pragma once

#include "sdk/qncore/QnDateTime.h"
#include "zoetrix/ui/AnimationDialog.h"

/// What the forms of both sun studies are: place, dates and times, step, file type, capture method
/// and viewport, with a button for the host's location picker.
class CSunStudyDialog : public CAnimationDialog {
public:
    /// Controls of the templates.
    enum control_id : int {
        first_date_time_id = 6000,
        second_date_time_id = 6001,
        third_date_time_id = 6002,
        latitude_id = 6004,
        longitude_id = 6005,
        north_angle_id = 6006,
        text_id = 6009,
        frame_step_id = 6010,
        location_button_id = 6015,
    };

    ~CSunStudyDialog() override;

    /// The location button: lets the person choose a place, which becomes the latitude and
    /// longitude and is shown in their fields with two digits behind the point. The members keep
    /// all digits until the fields are read.
    void OnBnClickedButton1();

    double m_latitude;    ///< degrees, -90 to 90, north positive
    double m_longitude;   ///< degrees, -180 to 180, east positive
    double m_north_angle; ///< degrees, 0 to 360, clockwise from the Y axis
    COleDateTime m_first_date_time;
    COleDateTime m_second_date_time;
    COleDateTime m_third_date_time;
    KM_wString m_text; ///< what it means is the caller's
    int m_frame_step;

protected:
    CSunStudyDialog(int template_id, double latitude, double longitude, double north_angle,
                    const COleDateTime& first_date_time, const COleDateTime& second_date_time,
                    const COleDateTime& third_date_time, const KM_wString& text,
                    const KM_ClassArray<KM_wString>& file_types, int file_type_selection,
                    const KM_ClassArray<KM_wString>& capture_methods, int capture_method_selection,
                    const KM_ClassArray<KM_wString>& viewports, int viewport_selection,
                    int frame_step, CWnd* parent);

    void DoDataExchange(CQnDialogExchange& exchange) override;
    void OnButton(int control) override;
};
