#pragma once

#include "host/recording/RecordedFolder.h"

#include <string>

namespace quarn {

/// What the script of a viewer page is told of a recording.
struct PageRecording {
    std::string title;
    bool is_one_file = false; ///< the pictures stand in the page
    int width_px = 0;         ///< of the first picture
    int height_px = 0;
    const FramesManifest& manifest; ///< of the pictures that the page shows; at least one
};

/// The frames that the page counts: of a turntable its whole turn, else up to the last one there.
int pageFrames(const FramesManifest& manifest);

/// Which way the near side of a turntable's model moves from frame to frame, as the cameras tell:
/// 1 to the right, -1 to the left. Without cameras as turntables turn that nobody told otherwise:
/// clockwise seen from above, to the left.
int turnOf(const FramesManifest& manifest);

/// As JSON; share/viewer/frames.js and its neighbours read it.
std::string pageRecordingJson(const PageRecording& recording);

} // namespace quarn
