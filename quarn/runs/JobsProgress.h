#pragma once

#include "host/session/RecordingProgress.h"
#include "quarn/scripts/DocumentRecordingScript.h"
#include "quarn/terminal/FramePace.h"
#include "quarn/terminal/ProgressLine.h"

#include <string>
#include <sys/types.h>

namespace quarn::program {

/// How far several recorders are with their frames, as the folder tells.
class JobsProgress {
public:
    /// Looks what is there before they begin.
    explicit JobsProgress(const DocumentRecordingRequest& request);

    /// Wanted frames that were there before.
    int keptBefore() const { return m_kept; }
    /// Whether the process has begun to record.
    bool hasWriter(pid_t process) const;
    /// Shows on a terminal how far they are; looks only now and then, as that takes time too.
    void show();
    void clear() { m_line.clear(); }
    /// What is told of them once they were stopped.
    std::string stoppedText() const;

private:
    struct Counts {
        int wanted = 0;
        int there = 0;
    };
    Counts count() const;

    const DocumentRecordingRequest& m_request;
    ProgressLine m_line;
    FramePace m_pace;
    FramePace::Clock::time_point m_next_look;
    int m_kept = 0;
    int m_shown = 0;
};

} // namespace quarn::program
