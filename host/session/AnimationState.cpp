#include "host/session/AnimationState.h"

#include "ground/PathText.h"
#include "host/border/Border.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

namespace {

bool canPlay(const KM_3dmAnimationProperties& record) {
    return record.FrameCount() > 0 && record.CameraPoints().Count() == record.FrameCount() &&
           record.TargetPoints().Count() == record.FrameCount();
}

AnimationState stateOf(const KM_3dmAnimationProperties& record) {
    AnimationState state;
    state.can_play = canPlay(record);
    state.is_sun_study = record.CaptureType() == KM_3dmAnimationProperties::one_day_sun ||
                         record.CaptureType() == KM_3dmAnimationProperties::seasonal_sun;
    if (state.can_play) {
        state.frame_count = record.FrameCount();
        state.current_frame = std::clamp(record.CurrentFrame(), 0, state.frame_count - 1);
    }
    state.name = record.HtmlFilename();
    state.view = record.ViewportName();
    state.folder = record.FolderName();
    if (!state.folder.IsEmpty())
        state.page_file = pathFromText((state.folder + L"/" + state.name + L".html").View());
    return state;
}

} // namespace

AnimationState animationState(CQuarnDoc& document) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return {};
    const auto state = acrossBorder([&] { return stateOf(access->AnimationProperties(document)); });
    return state ? state.value() : AnimationState();
}

} // namespace quarn
