#pragma once

#include "host/front_end/RecordingReport.h"
#include "kelmar/KM_Viewport.h"

#include <filesystem>

namespace quarn {

struct Image;

/// A frame of a recording that stands written.
struct RecordedFrame {
    int number; ///< from 0
    const std::filesystem::path& file;
    const KM_Viewport& camera; ///< that it was drawn with
    const Image& picture;      ///< what the file holds
};

/// Follows a recording while it is made. All is called on the main thread; what the recording wrote
/// stands, whatever a follower does.
class RecordingFollower {
public:
    virtual ~RecordingFollower() = default;

    /// After a frame was written. What the frame refers to lives as long as the call; work that
    /// takes long belongs on another thread.
    virtual void frameRecorded(const RecordedFrame& frame) = 0;
    /// In place of that, for a frame that was there already, whole.
    virtual void frameKept(int number, const std::filesystem::path& file) = 0;
    /// Once, when the recording has ended, whole or not; followers are called in the order in which
    /// they were added. Not called where the recording never began in its folder.
    virtual void recordingEnded(const RecordingReport& report) = 0;
};

} // namespace quarn
