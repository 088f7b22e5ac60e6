#pragma once

#include "sdk/qncore/QnCommand.h"

namespace quarn {

class Application;

/// While it lives the command that records animations runs, if it is that one: what the command
/// writes is watched over, and at the end the front end is told what there is. Of recordings that
/// nest the outer one counts.
class RecordingScope {
public:
    RecordingScope(Application& application, CQuarnCommand& command, CQuarnDoc& document);
    ~RecordingScope();
    RecordingScope(const RecordingScope&) = delete;
    RecordingScope& operator=(const RecordingScope&) = delete;

private:
    Application& m_application;
    bool m_is_recording;
};

} // namespace quarn
