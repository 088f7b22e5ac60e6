#include "host/session/AnimationState.h"

#include "ground/PathText.h"
#include "host/border/Border.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

namespace {

AnimationState stateOf(const KM_3dmAnimationProperties& record) {
    AnimationState state;
    state.can_play = record.IsPlayable();
    state.is_sun_study = record.IsSunStudy();
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
