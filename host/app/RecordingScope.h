#pragma once

#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnCommand.h"

#include <optional>

namespace quarn {

class Application;
class Document;

/// While it lives the command that records animations runs, if it is that one: what the command
/// writes is watched over, and at the end the front end is told what there is. Of recordings that
/// nest the outer one counts. The view that was recorded has its camera back then to the last bit:
/// a playback puts it back by way of its target, and a recording is known by it.
class RecordingScope {
public:
    RecordingScope(Application& application, CQuarnCommand& command, CQuarnDoc& document);
    ~RecordingScope();
    RecordingScope(const RecordingScope&) = delete;
    RecordingScope& operator=(const RecordingScope&) = delete;

private:
    void putCameraBack();

    Application& m_application;
    Document& m_document;
    bool m_is_recording;
    KM_wString m_view_name;
    std::optional<KM_Viewport> m_camera_before; ///< of that view
};

} // namespace quarn
