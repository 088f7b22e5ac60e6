#pragma once

#include "zoetrix/ui/SunStudyDialog.h"

/// The form of a sun study of one day: the first date-time is the day, the second the start time,
/// the third the end time.
class CSunDialog : public CSunStudyDialog {
public:
    static const CQnRuntimeClass ClassRecord;
    static constexpr int template_id = 6006;

    /// @param latitude     degrees, north positive
    /// @param longitude    degrees, east positive
    /// @param north_angle  degrees, clockwise from the Y axis
    /// @param day          the day; its time of day means nothing
    /// @param start_time   the time of the first frame; its date means nothing
    /// @param end_time     the time that no frame lies behind; likewise
    /// @param text         what it means is the caller's
    /// @param frame_step   minutes between frames
    /// @param parent       the window that owns the dialog; may be null
    CSunDialog(double latitude, double longitude, double north_angle, const COleDateTime& day,
               const COleDateTime& start_time, const COleDateTime& end_time, const KM_wString& text,
               const KM_ClassArray<KM_wString>& file_types, int file_type_selection,
               const KM_ClassArray<KM_wString>& capture_methods, int capture_method_selection,
               const KM_ClassArray<KM_wString>& viewports, int viewport_selection, int frame_step,
               CWnd* parent);
    ~CSunDialog() override;

    const CQnRuntimeClass* GetRuntimeClass() const override;
};
