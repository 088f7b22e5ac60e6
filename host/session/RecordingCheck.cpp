#include "host/session/RecordingCheck.h"

#include "host/recording/FrameMemory.h"
#include "host/recording/FrameRanges.h"
#include "host/recording/RecordingPlace.h"

namespace quarn {

std::optional<std::string> whyRecordingIsRefused(const RecordingTarget& target) {
    const RecordingPlace place{target.folder, target.name, target.extension, target.frames};
    const auto there = readRecordingFile(place.recordingFile());
    const bool is_shared = there && there.value() && there.value()->is_shared;
    if (!(target.may_go_on && is_shared))
        if (const auto writer = whoRecords(place))
            return isRecorded(place, *writer).message;
    const auto checked = checkRecordingPlace(place, target.overwrites);
    return checked ? std::nullopt : std::optional(checked.message());
}

std::optional<std::string> whyFramesAreRefused(const std::string& ranges) {
    const auto frames = parseFrameRanges(ranges);
    return frames ? std::nullopt : std::optional(frames.message());
}

bool isFolderForRecordings(const std::filesystem::path& folder) {
    namespace fs = std::filesystem;
    std::error_code error;
    if (!fs::exists(folder, error))
        return !error;
    bool is_empty = true;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error)) {
        is_empty = false;
        if (at->path().extension() != ".recording")
            continue;
        if (const auto recording = readRecordingFile(at->path()); recording && recording.value())
            return true;
    }
    return is_empty && !error;
}

std::optional<std::string> whyTooManyFrames(int frames) {
    const std::optional<KM_wString> why = framesBeyondMemory(frames);
    return why ? std::optional(why->ToUtf8() + ".") : std::nullopt;
}

} // namespace quarn
