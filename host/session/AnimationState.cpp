#include "host/session/AnimationState.h"

#include "ground/PathText.h"
#include "host/app/StudyMoments.h"
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

/// @param told  "2026-06-21T14:30:00"
KM_wString timeText(const FrameSun& told) {
    constexpr std::size_t DATE = 10;
    constexpr std::size_t MINUTES = 5;
    return KM_wString::FromUtf8(told.time.substr(0, DATE) + " " +
                                told.time.substr(DATE + 1, MINUTES) + " " + told.zone);
}

std::vector<KM_wString> timesOf(const KM_3dmAnimationProperties& record,
                                const std::optional<Zone>& zone) {
    std::vector<KM_wString> times;
    for (int frame = 0; record.IsSunStudy() && frame < record.Dates().Count(); ++frame) {
        const auto told = zone ? sunOfFrame(record, frame, zone) : std::nullopt;
        times.push_back(told ? timeText(*told) : record.Dates()[frame]);
    }
    return times;
}

} // namespace

AnimationState animationState(CQuarnDoc& document) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return {};
    const auto state = acrossBorder([&] { return stateOf(access->AnimationProperties(document)); });
    return state ? state.value() : AnimationState();
}

std::vector<KM_wString> frameTimes(CQuarnDoc& document) {
    const KM_3dmAnimationProperties record = document.Properties().AnimationProperties();
    return timesOf(record, studyZone(Document::of(document), record));
}

} // namespace quarn
