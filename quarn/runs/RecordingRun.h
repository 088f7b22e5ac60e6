#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/FrameRanges.h"
#include "quarn/words/Outcome.h"

#include <chrono>
#include <filesystem>
#include <optional>

namespace quarn::program {

/// A recording that is to be run in a session whose document has its animation.
struct RecordingRun {
    const RecordingScript& script; ///< from `saving` on
    std::filesystem::path folder;
    std::filesystem::path page; ///< that the recording writes, or does not where it is a part
    int frames = 0;             ///< of the animation
    FrameRanges part{};         ///< that is wanted of it
    int retries = 0;            ///< how often frames that failed are tried again
    bool names_missing = false; ///< whether a recording that lacks frames tells their numbers
    /// Whether frames that other programs record are waited for; else they are left to them.
    bool waits_for_others = true;
    /// Frames that were there before the work began; nothing: those that the recording finds.
    std::optional<int> kept_before{};
};

/// NAME.recording in its folder, which may hold other recordings too.
std::filesystem::path recordingFile(const RecordingRun& run);

/// Runs the recording, and makes of its frames what the script asks for.
/// @param start  when the work began, for the time that is told
Outcome runRecording(const RecordingRun& run, HostSession& host,
                     std::chrono::steady_clock::time_point start);

} // namespace quarn::program
