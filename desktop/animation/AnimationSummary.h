#pragma once

#include "host/session/AnimationState.h"
#include "sdk/qncore/QnDoc.h"

#include <QString>
#include <QStringList>

#include <optional>

namespace quarn::desktop {

/// What the window shows of the animation that is set up in a document.
struct AnimationSummary {
    AnimationState state;
    QStringList dates; ///< date and time of the frames of a sun study; else empty

    int lastFrame() const { return state.frame_count > 0 ? state.frame_count - 1 : 0; }
    /// The date and time of a frame; empty where the animation has none.
    QString dateOf(int frame) const { return dates.value(frame); }
};

AnimationSummary animationSummary(CQuarnDoc& document);

/// The command line that opens the page of the last recording; nothing where there is none, and
/// for a path that no command line can hold.
std::optional<QString> pageOpeningLine(const AnimationState& animation);

/// The command line that records the animation: it begins with the folder chooser as long as no
/// folder was chosen.
QString recordingLine(CQuarnDoc& document);

} // namespace quarn::desktop
