#pragma once

#include "quarn/runs/RecordingRun.h"

namespace quarn::program {

/// How the commands of a recording ended.
struct PassesEnd {
    /// All passes as one; nothing: the host refused to record.
    std::optional<EndedRecording> recording;
    /// Why the host refused, or why frames that others record are waited for no longer; a sentence,
    /// or empty.
    std::string reason;
};

/// Records until every wanted frame is there: again where others record some of them at the same
/// time, and where frames failed and may be tried again.
PassesEnd runPasses(const RecordingRun& run, HostSession& host);

} // namespace quarn::program
