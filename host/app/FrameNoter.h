#pragma once

#include "host/clock/Zone.h"
#include "host/recording/RecordingFollower.h"
#include "kelmar/KM_AnimationProperties.h"

#include <optional>

namespace quarn {

class RunningRecording;

/// Notes what is known of each frame of a recording in its journal.
class FrameNoter final : public RecordingFollower {
public:
    /// @param record     as the recording begins with it
    /// @param zone       that the times of a sun study are told by, as studyZone has it
    /// @param recording  outlives this
    FrameNoter(const KM_3dmAnimationProperties& record, std::optional<Zone> zone,
               RunningRecording& recording)
        : m_record(record), m_zone(std::move(zone)), m_recording(recording) {}

    void frameRecorded(const RecordedFrame& frame) override;
    void frameKept(int, const std::filesystem::path&) override {}
    void recordingEnded(const RecordingReport&) override {}

private:
    KM_3dmAnimationProperties m_record;
    std::optional<Zone> m_zone;
    RunningRecording& m_recording;
};

} // namespace quarn
