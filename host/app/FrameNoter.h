#pragma once

#include "host/recording/RecordingFollower.h"
#include "kelmar/KM_AnimationProperties.h"

namespace quarn {

class RunningRecording;

/// Notes what is known of each frame of a recording in its journal.
class FrameNoter final : public RecordingFollower {
public:
    /// @param record     as the recording begins with it
    /// @param recording  outlives this
    FrameNoter(const KM_3dmAnimationProperties& record, RunningRecording& recording)
        : m_record(record), m_recording(recording) {}

    void frameRecorded(const RecordedFrame& frame) override;
    void frameKept(int, const std::filesystem::path&) override {}
    void recordingEnded(const RecordingReport&) override {}

private:
    KM_3dmAnimationProperties m_record;
    RunningRecording& m_recording;
};

} // namespace quarn
