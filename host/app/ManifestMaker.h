#pragma once

#include "host/recording/FramesManifest.h"
#include "host/recording/RecordingFile.h"
#include "host/recording/RecordingFollower.h"
#include "kelmar/KM_AnimationProperties.h"

#include <functional>

namespace quarn {

class Document;

/// Notes what is known of each frame of a recording, and writes the list of them beside them once
/// all are there.
class ManifestMaker final : public RecordingFollower {
public:
    using Tell = std::function<void(const std::string&)>;

    /// @param record    as the recording begins with it
    /// @param document  what is recorded; outlives this
    /// @param tell      shows a person a sentence
    ManifestMaker(const KM_3dmAnimationProperties& record, const std::string& animation,
                  const RecordingSettings& settings, Document& document, Tell tell);

    void frameRecorded(const RecordedFrame& frame) override;
    void recordingEnded(const RecordingReport& report) override;

private:
    std::string documentFingerprint() const;
    std::string settingsFingerprint() const;

    KM_3dmAnimationProperties m_record;
    RecordingSettings m_settings;
    Document& m_document;
    Tell m_tell;
    FramesManifest m_manifest;
};

} // namespace quarn
