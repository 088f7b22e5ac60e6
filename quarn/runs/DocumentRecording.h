#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/scripts/DocumentRecordingScript.h"

#include <chrono>

namespace quarn::program {

/// What is done about frames that cannot be made at once.
struct FrameCare {
    int retries = 0;            ///< how often frames that failed are tried again
    bool names_missing = false; ///< whether the numbers of those that are missing are told
    /// Whether the program is one of several recorders of the same frames that another program
    /// started: it leaves the page, and frames that others record, to that one.
    bool is_recorder = false;
    /// Frames that were there before the work began; nothing: those that the recording finds.
    std::optional<int> kept_before{};
};

/// Records the stored animation of a document, in this process. Watches for interruption already.
/// @param start  when the work began, for the time that is told
Outcome recordHere(const DocumentRecordingRequest& request, const FrameCare& care,
                   const CommonOptions& common, std::chrono::steady_clock::time_point start);

/// `quarn record`: composes a script that records the stored animation of a document, or a part of
/// it, and runs it or returns it.
/// @param jobs  how many recorders share the frames, each a process of its own
Outcome recordDocument(const DocumentRecordingRequest& request, int jobs, const ScriptUse& use);

/// One of the recorders that recordDocument starts.
Outcome runRecorder(const DocumentRecordingRequest& request, const CommonOptions& common);

} // namespace quarn::program
