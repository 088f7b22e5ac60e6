#include "desktop/animation/AnimationSummary.h"

#include "desktop/documents/StartedLine.h"
#include "desktop/texts/Texts.h"

#include <system_error>

namespace quarn::desktop {

namespace {

QStringList datesOf(CQuarnDoc& document) {
    QStringList dates;
    for (const KM_wString& time : frameTimes(document))
        dates.append(qtText(time));
    return dates;
}

} // namespace

AnimationSummary animationSummary(CQuarnDoc& document) {
    AnimationSummary animation{animationState(document), {}};
    if (animation.state.can_play && animation.state.is_sun_study)
        animation.dates = datesOf(document);
    return animation;
}

std::optional<QString> pageOpeningLine(const AnimationState& animation) {
    std::error_code error;
    const QString path = quotedPath(animation.page_file);
    if (path.isEmpty() || !std::filesystem::is_regular_file(animation.page_file, error))
        return std::nullopt;
    return "_Run " + path;
}

QString recordingLine(CQuarnDoc& document) {
    const AnimationState animation = animationState(document);
    const bool needs_folder = animation.can_play && animation.folder.IsEmpty();
    return needs_folder ? "_RecordAnimation _TargetFolder" : "_RecordAnimation";
}

} // namespace quarn::desktop
