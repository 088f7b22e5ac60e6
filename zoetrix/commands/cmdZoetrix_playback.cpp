#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnPlatform.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/PlaybackScopes.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

namespace {

/// The frames to show. Counted, so that a stored frame number may be as large as it likes.
struct FrameRange {
    int first;
    int count;
};

/// What showing frames works on.
struct Playback {
    CQuarnDoc& doc;
    KM_3dmAnimationProperties& props;
    CQuarnView& view;
    FrameRange frames;
    bool plays_all; ///< and puts the view back afterwards
    bool records;
};

/// Takes the frame points from the curves as they are now, and hides the curves.
void FollowAndHidePaths(KM_3dmAnimationProperties& props, HiddenPaths& paths) {
    if (!props.FollowsCurves())
        return;
    CZoetrixUtilities::ResetAnimation(props);
    paths.Hide(props.FollowedCurves());
}

/// Shows every frame of the playback.
/// @param set_up  called with each frame's camera and target point; not for a frame that has none:
///                after a stored frame number out of range, or a curve that yields fewer points
template <class SetUp> void ShowFrames(Playback& playback, SetUp&& set_up) {
    KM_3dmAnimationProperties& props = playback.props;
    for (int shown = 0; shown < playback.frames.count; ++shown) {
        const int i = playback.frames.first + shown;
        props.SetCurrentFrame(i);
        const KM_3dPoint* camera = props.CameraPoints().At(i);
        const KM_3dPoint* target = props.TargetPoints().At(i);
        if (camera && target)
            set_up(*camera, *target);
        if (!playback.records)
            playback.view.Redraw();
        else if (!RecordFrame(playback.doc.RuntimeSerialNumber(), props, &playback.view))
            return;
        WaitAndCheckForEscapeKey(1);
    }
}

/// Draws the view in the record's display mode once before the first frame.
void EnterDisplayMode(Playback& playback) {
    playback.view.Viewport().SetDisplayMode(playback.props.DisplayMode());
    playback.view.Redraw();
    QuarnApp().Wait(0);
}

void ShowSunStudy(Playback& playback) {
    const SunSwitchedOff sun(playback.doc);
    StudyLight light(playback.doc, playback.props);
    playback.props.SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId());
    EnterDisplayMode(playback);
    ShowFrames(playback, [&light](const KM_3dPoint& camera, const KM_3dPoint& target) {
        light.Shine(camera, target);
    });
}

void ShowCameraAnimation(Playback& playback) {
    CQuarnViewport& viewport = playback.view.Viewport();
    const SavedCamera camera_before(viewport, playback.plays_all);
    if (KM_UuidIsNil(playback.props.DisplayMode()))
        playback.props.SetDisplayMode(CQuarnDisplayAttrsMgr::WireframeModeId());
    EnterDisplayMode(playback);
    ShowFrames(playback, [&viewport](const KM_3dPoint& camera, const KM_3dPoint& target) {
        viewport.SetTargetAndCameraLocation(target, camera, true, true);
    });
}

/// @param frame  from 0, or negative for all
FrameRange FramesToShow(const KM_3dmAnimationProperties& props, int frame) {
    return frame < 0 ? FrameRange{0, props.FrameCount()} : FrameRange{frame, 1};
}

} // namespace

int PreviewAnimation(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int frame, bool record) {
    if (!props.IsPlayable())
        return EndWith(L"No animation is currently set. There is nothing to view\n", 16773,
                       CQuarnCommand::failure);

    HiddenPaths paths(doc);
    FollowAndHidePaths(props, paths);

    KM_wString view_name = props.ViewportName();
    view_name.TrimLeftAndRight();
    if (view_name.IsEmpty())
        return EndWith(L"Invalid view name. Nothing done\n", 16774, CQuarnCommand::failure);
    CQuarnView* view = CZoetrixUtilities::FindQuarnViewByName(doc, view_name, true);
    if (!view)
        return EndWith(L"Unable to find viewport to play animation\n", 16775,
                       CQuarnCommand::failure);

    paths.ShowAgainAtEnd();
    const bool plays_all = frame < 0;
    const SavedDisplayMode mode_before(*view, plays_all);
    KM_wString extension = props.FileExtension();
    CleanExtention(extension);
    props.SetFileExtension(extension);

    Playback playback{doc, props, *view, FramesToShow(props, frame), plays_all, record};
    if (props.IsSunStudy())
        ShowSunStudy(playback);
    else
        ShowCameraAnimation(playback);
    return CQuarnCommand::success;
}

bool WaitAndCheckForEscapeKey(unsigned int milliseconds) {
    constexpr unsigned int step_ms = 10;
    const unsigned int start = GetTickCount();
    do {
        if (GetAsyncKeyState(VK_ESCAPE) < 0)
            return false;
        QuarnApp().Wait(step_ms);
    } while (GetTickCount() - start < milliseconds);
    return false;
}
