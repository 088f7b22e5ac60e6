#include "host/session/RecordingCheck.h"

#include "host/recording/FrameMemory.h"
#include "host/recording/RecordingPlace.h"

namespace quarn {

std::optional<std::string> whyRecordingIsRefused(const RecordingTarget& target) {
    const RecordingPlace place{target.folder, target.name, target.extension, target.frames};
    const auto checked = checkRecordingPlace(place, target.overwrites);
    return checked ? std::nullopt : std::optional(checked.message());
}

std::optional<std::string> whyTooManyFrames(int frames) {
    const std::optional<KM_wString> why = framesBeyondMemory(frames);
    return why ? std::optional(why->ToUtf8() + ".") : std::nullopt;
}

} // namespace quarn
