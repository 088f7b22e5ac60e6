#pragma once

#include "zoetrix/ui/SunStudyDialog.h"

/// The form of a sun study of a season: the first date-time is the start date, the second the end
/// date, the third the time of day.
class CSeasonDialog : public CSunStudyDialog {
public:
    static const CQnRuntimeClass ClassRecord;
    static constexpr int template_id = 6007;

    /// @param latitude     degrees, north positive
    /// @param longitude    degrees, east positive
    /// @param north_angle  degrees, clockwise from the Y axis
    /// @param start_date   the day of the first frame; its time of day means nothing
    /// @param end_date     the day that no frame lies behind; likewise
    /// @param time_of_day  the time of every frame; its date means nothing
    /// @param text         what it means is the caller's
    /// @param frame_step   days between frames
    /// @param parent       the window that owns the dialog; may be null
    CSeasonDialog(double latitude, double longitude, double north_angle,
                  const COleDateTime& start_date, const COleDateTime& end_date,
                  const COleDateTime& time_of_day, const KM_wString& text,
                  const KM_ClassArray<KM_wString>& file_types, int file_type_selection,
                  const KM_ClassArray<KM_wString>& capture_methods, int capture_method_selection,
                  const KM_ClassArray<KM_wString>& viewports, int viewport_selection,
                  int frame_step, CWnd* parent);
    ~CSeasonDialog() override;

    const CQnRuntimeClass* GetRuntimeClass() const override;
};
