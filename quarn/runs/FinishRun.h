#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/scripts/DocumentRecordingScript.h"

namespace quarn::program {

/// A recording that is to be brought to its end.
struct FinishRequest {
    std::filesystem::path recorded; ///< its folder, or the file NAME.recording in it
    std::filesystem::path document; ///< empty: the one that it was recorded from
    int retries = 0;                ///< how often frames that fail are tried again
    std::optional<int> quality;     ///< of jpg; nothing: the host's
    FilmRequest film;
    ViewerRequest viewer;
};

/// `quarn finish`: makes the frames that are missing or damaged in the folder of a recording again,
/// then its page, its list of frames, and what is asked for besides; or returns the script.
Outcome finishRecording(const FinishRequest& request, const ScriptUse& use);

} // namespace quarn::program
