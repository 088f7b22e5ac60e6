#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_Export.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"

#include <cstdint>

class KM_BinaryArchive;

/// The animation that is set up in a document: what kind it is, where camera and target are in
/// every frame, date and place of a sun study, how frames are drawn and where recordings go.
///
/// A plain value: copies are deep. Setters store what they are given; nothing is checked, so ask
/// IsPlayable before frames are shown. References that getters return live as long as the record
/// and follow its changes.
class KELMAR_API KM_3dmAnimationProperties {
public:
    /// What moves. Documents store the values.
    enum CaptureTypes : std::int32_t {
        /// The camera follows one curve, the target another or a point.
        path = 0,
        /// The camera circles the target.
        turntable = 1,
        /// The camera follows one curve and looks ahead along it.
        flythrough = 2,
        /// The sun moves through one day.
        one_day_sun = 3,
        /// The sun at one time of day, over many days.
        seasonal_sun = 4,
        /// No animation is set up.
        none = 5,
    };

    /// A record without an animation, with the defaults given at the fields below. Texts, ids and
    /// arrays without a stated default are empty or nil.
    KM_3dmAnimationProperties();
    KM_3dmAnimationProperties(const KM_3dmAnimationProperties& other);
    /// Copies every field; a record may be assigned to itself.
    KM_3dmAnimationProperties& operator=(const KM_3dmAnimationProperties& other);
    /// Takes every field over from `other`, whose texts and arrays are unspecified afterwards.
    KM_3dmAnimationProperties& operator=(KM_3dmAnimationProperties&& other) noexcept;
    ~KM_3dmAnimationProperties();

    /// Writes every field, as a chunk with a layout version of its own.
    /// @return false when the archive fails, and when the record is one that Read refuses: its
    ///         capture type is none of the list, or a coordinate of its points is not finite
    bool Write(KM_BinaryArchive& archive) const;

    /// Replaces every field by what Write wrote, to the last bit. Fields that an older layout lacks
    /// get their defaults; what a newer minor layout adds is skipped. Frame count, frame numbers
    /// and dates are taken as they are, so look before playing whether the record can be played.
    /// @return false, with this record unchanged and the archive failed, when the chunk is cut or
    ///         damaged, has a newer major layout, or holds what no record can: an unknown capture
    ///         type, a coordinate that is not finite, a bool other than 0 and 1, ill-formed UTF-8
    bool Read(KM_BinaryArchive& archive);

    /// Whether the sun moves, and not the camera: the study of a day or of a season.
    bool IsSunStudy() const;
    /// Whether there is an animation to show: at least one frame, and as many camera and target
    /// points as frames.
    bool IsPlayable() const;
    /// Whether the frame points come from curves of the document: of a path both camera and target
    /// have one, of a flythrough the camera has. A path of one curve and a point stays as it was
    /// set up.
    bool FollowsCurves() const;
    /// Ids of the curves that are followed, the camera's first. They are hidden while frames are
    /// shown. Empty when the record does not follow curves.
    KM_SimpleArray<KM_UUID> FollowedCurves() const;

    /// Kind of animation that is set up. Default: none.
    CaptureTypes CaptureType() const { return m_capture_type; }
    void SetCaptureType(CaptureTypes capture_type) { m_capture_type = capture_type; }

    /// Extension of recorded frame files, without the dot. Default: "jpg".
    const KM_wString& FileExtension() const { return m_file_extension; }
    void SetFileExtension(const KM_wString& file_extension) { m_file_extension = file_extension; }

    /// Name of the capture method or display mode that draws the frames.
    const KM_wString& CaptureMethod() const { return m_capture_method; }
    void SetCaptureMethod(const KM_wString& capture_method) { m_capture_method = capture_method; }

    /// Name of the view whose viewport is animated.
    const KM_wString& ViewportName() const { return m_viewport_name; }
    void SetViewportName(const KM_wString& viewport_name) { m_viewport_name = viewport_name; }

    /// Base name of the animation: of its folder, its frame files and its page.
    const KM_wString& HtmlFilename() const { return m_html_filename; }
    void SetHtmlFilename(const KM_wString& html_filename) { m_html_filename = html_filename; }

    /// Id of the display mode of previews and recordings.
    const KM_UUID& DisplayMode() const { return m_display_mode; }
    void SetDisplayMode(const KM_UUID& display_mode) { m_display_mode = display_mode; }

    /// Camera location of each frame in model units, frame 0 first. In a sun study: the tip of the
    /// unit vector from the world origin toward the sun.
    const KM_3dPointArray& CameraPoints() const { return m_camera_points; }
    KM_3dPointArray& CameraPoints() { return m_camera_points; }

    /// Camera target of each frame in model units, frame 0 first. In a sun study: the world origin.
    const KM_3dPointArray& TargetPoints() const { return m_target_points; }
    KM_3dPointArray& TargetPoints() { return m_target_points; }

    /// Number of frames. Default: 100.
    std::int32_t FrameCount() const { return m_frame_count; }
    void SetFrameCount(std::int32_t frame_count) { m_frame_count = frame_count; }

    /// Frame that was shown last, counted from 0. Default: 1.
    std::int32_t CurrentFrame() const { return m_current_frame; }
    void SetCurrentFrame(std::int32_t current_frame) { m_current_frame = current_frame; }

    /// Id of the document's curve that the camera follows (path and flythrough).
    const KM_UUID& CameraPathId() const { return m_camera_path_id; }
    void SetCameraPathId(const KM_UUID& camera_path_id) { m_camera_path_id = camera_path_id; }

    /// Id of the document's curve that the target follows (path).
    const KM_UUID& TargetPathId() const { return m_target_path_id; }
    void SetTargetPathId(const KM_UUID& target_path_id) { m_target_path_id = target_path_id; }

    /// Latitude of a sun study's site in degrees, north positive. Default: 51.2838.
    double Latitude() const { return m_latitude; }
    void SetLatitude(double latitude) { m_latitude = latitude; }

    /// Longitude of a sun study's site in degrees, east positive. Default: 0.0.
    double Longitude() const { return m_longitude; }
    void SetLongitude(double longitude) { m_longitude = longitude; }

    /// Angle of north in the model, in degrees. Default: 0.0.
    double NorthAngle() const { return m_north_angle; }
    void SetNorthAngle(double north_angle) { m_north_angle = north_angle; }

    /// First day of the study: day of the month, from 1. Default: 1.
    std::int32_t StartDay() const { return m_start_day; }
    void SetStartDay(std::int32_t start_day) { m_start_day = start_day; }

    /// Month of the first day, from 1. Default: 6.
    std::int32_t StartMonth() const { return m_start_month; }
    void SetStartMonth(std::int32_t start_month) { m_start_month = start_month; }

    /// Year of the first day. Default: 2010.
    std::int32_t StartYear() const { return m_start_year; }
    void SetStartYear(std::int32_t start_year) { m_start_year = start_year; }

    /// Last day of a seasonal study: day of the month, from 1. Default: 1.
    std::int32_t EndDay() const { return m_end_day; }
    void SetEndDay(std::int32_t end_day) { m_end_day = end_day; }

    /// Month of the last day, from 1. Default: 6.
    std::int32_t EndMonth() const { return m_end_month; }
    void SetEndMonth(std::int32_t end_month) { m_end_month = end_month; }

    /// Year of the last day. Default: 2012.
    std::int32_t EndYear() const { return m_end_year; }
    void SetEndYear(std::int32_t end_year) { m_end_year = end_year; }

    /// Time of day of the first frame: hours, 0 to 23. Default: 6.
    std::int32_t StartHour() const { return m_start_hour; }
    void SetStartHour(std::int32_t start_hour) { m_start_hour = start_hour; }

    /// Minutes of the first frame's time. Default: 0.
    std::int32_t StartMinutes() const { return m_start_minutes; }
    void SetStartMinutes(std::int32_t start_minutes) { m_start_minutes = start_minutes; }

    /// Seconds of the first frame's time. Default: 0.
    std::int32_t StartSeconds() const { return m_start_seconds; }
    void SetStartSeconds(std::int32_t start_seconds) { m_start_seconds = start_seconds; }

    /// Time of day of a one-day study's last frame: hours, 0 to 23. Default: 18.
    std::int32_t EndHour() const { return m_end_hour; }
    void SetEndHour(std::int32_t end_hour) { m_end_hour = end_hour; }

    /// Minutes of the last frame's time. Default: 0.
    std::int32_t EndMinutes() const { return m_end_minutes; }
    void SetEndMinutes(std::int32_t end_minutes) { m_end_minutes = end_minutes; }

    /// Seconds of the last frame's time. The default end is 18:00:59, so that a frame that falls on
    /// 18:00:00 is still within the study. Default: 59.
    std::int32_t EndSeconds() const { return m_end_seconds; }
    void SetEndSeconds(std::int32_t end_seconds) { m_end_seconds = end_seconds; }

    /// Step of a seasonal study in days. Default: 30.
    std::int32_t DaysBetweenFrames() const { return m_days_between_frames; }
    void SetDaysBetweenFrames(std::int32_t days_between_frames) {
        m_days_between_frames = days_between_frames;
    }

    /// Step of a one-day study in minutes. Default: 30.
    std::int32_t MinutesBetweenFrames() const { return m_minutes_between_frames; }
    void SetMinutesBetweenFrames(std::int32_t minutes_between_frames) {
        m_minutes_between_frames = minutes_between_frames;
    }

    /// Index in the document's light table of the light that a sun study moves; -1 when there is
    /// none yet. Default: -1.
    std::int32_t LightIndex() const { return m_light_index; }
    void SetLightIndex(std::int32_t light_index) { m_light_index = light_index; }

    /// Folder that recorded frames and the page are written to.
    const KM_wString& FolderName() const { return m_folder_name; }
    void SetFolderName(const KM_wString& folder_name) { m_folder_name = folder_name; }

    /// File names of the recorded frames, in the order of frames.
    KM_ClassArray<KM_wString>& Images() { return m_images; }

    /// Label (date and time) of each frame of a sun study, in the order of frames.
    const KM_ClassArray<KM_wString>& Dates() const { return m_dates; }
    KM_ClassArray<KM_wString>& Dates() { return m_dates; }

    /// Whether frames are recorded with the full renderer. Default: false.
    bool RenderFull() const { return m_render_full; }
    void SetRenderFull(bool render_full) { m_render_full = render_full; }

    /// Whether frames are recorded with the preview renderer. Default: false.
    bool RenderPreview() const { return m_render_preview; }
    void SetRenderPreview(bool render_preview) { m_render_preview = render_preview; }

private:
    struct Fields;

    CaptureTypes m_capture_type = none;
    KM_wString m_file_extension = L"jpg";
    KM_wString m_capture_method;
    KM_wString m_viewport_name;
    KM_wString m_html_filename;
    KM_UUID m_display_mode;
    KM_3dPointArray m_camera_points;
    KM_3dPointArray m_target_points;
    std::int32_t m_frame_count = 100;
    std::int32_t m_current_frame = 1;
    KM_UUID m_camera_path_id;
    KM_UUID m_target_path_id;
    double m_latitude = 51.2838;
    double m_longitude = 0.0;
    double m_north_angle = 0.0;
    std::int32_t m_start_day = 1;
    std::int32_t m_start_month = 6;
    std::int32_t m_start_year = 2010;
    std::int32_t m_end_day = 1;
    std::int32_t m_end_month = 6;
    std::int32_t m_end_year = 2012;
    std::int32_t m_start_hour = 6;
    std::int32_t m_start_minutes = 0;
    std::int32_t m_start_seconds = 0;
    std::int32_t m_end_hour = 18;
    std::int32_t m_end_minutes = 0;
    std::int32_t m_end_seconds = 59;
    std::int32_t m_days_between_frames = 30;
    std::int32_t m_minutes_between_frames = 30;
    std::int32_t m_light_index = -1;
    KM_wString m_folder_name;
    KM_ClassArray<KM_wString> m_images;
    KM_ClassArray<KM_wString> m_dates;
    bool m_render_full = false;
    bool m_render_preview = false;
};
