#pragma once

#include "host/recording/RecordingJournal.h"

#include <map>
#include <vector>

namespace quarn {

/// The frames of a recording that its folder tells of: its list of frames, and the journals of all
/// who record it, of which only those with the same fingerprint count. Reads nothing before it is
/// asked to.
class KnownFrames {
public:
    struct Place {
        std::filesystem::path folder;
        std::string animation; ///< the name
    };
    KnownFrames(Place place, RecordingFingerprint fingerprint);

    /// Reads the list of frames, once, and what the journals have got since the last call.
    void refresh();

    /// What is known of a frame; null where nobody tells of it.
    const ManifestFrame* find(int frame) const;
    /// Whether the frame's file is what was recorded: reads it.
    bool isWhole(const ManifestFrame& frame) const;
    /// Whether the frame's file is there and as long as what was recorded.
    bool isThere(const ManifestFrame& frame) const;
    /// Puts one that was made now in place of what is known.
    void put(const ManifestFrame& frame) { m_frames[frame.number] = frame; }

    const std::map<int, ManifestFrame>& frames() const { return m_frames; }
    const std::vector<JournalReader>& journals() const { return m_journals; }
    /// Reads on in the journal of this name. @return null where there is none
    const JournalReader* journal(const std::string& file_name);

private:
    void readManifest();
    void readOn(JournalReader& journal);
    JournalReader& readerOf(const std::filesystem::path& file);

    Place m_place;
    RecordingFingerprint m_fingerprint;
    bool m_has_read_manifest = false;
    std::map<int, ManifestFrame> m_frames;
    std::vector<JournalReader> m_journals;
};

} // namespace quarn
