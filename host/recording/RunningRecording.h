#pragma once

#include "host/front_end/RecordingReport.h"
#include "host/recording/FrameClaim.h"
#include "host/recording/KnownFrames.h"
#include "host/recording/RecordingPlace.h"
#include "host/recording/RecordingPlan.h"

#include <chrono>
#include <functional>
#include <optional>

namespace quarn {

/// A recording of an animation while its command runs: it takes the folder, decides which frames
/// are made and which files may be written there, keeps its journal alive and counts what there is.
class RunningRecording {
public:
    /// How often the journal is renewed, and for how long it counts without that.
    struct Pace {
        std::chrono::seconds beat{5};
        std::chrono::seconds lease = JOURNAL_LEASE;
    };
    /// What a person is told, and who shows it.
    struct Listener {
        std::function<void(const std::string&)> tell; ///< a sentence in UTF-8
        std::function<void(const RecordingStart&)> begun = [](const RecordingStart&) {};
    };

    RunningRecording(RecordingPlan plan, Listener listener);
    RunningRecording(RecordingPlan plan, Listener listener, Pace pace);

    /// The folder is there, and the pictures come next. Only the first folder counts.
    /// @return false, told once, where the recording may not take place there
    bool begin(const std::filesystem::path& folder);

    /// Whether the frame that comes next is to be made; it is claimed then. Frames come in their
    /// order, and each ends with its file.
    bool makesNext();
    /// Whether a file is left as it is and counts as written: a frame that is not to be made, or
    /// the page of a recording that has not all its frames.
    bool passesOver(const std::filesystem::path& file);
    /// Whether the frame before was passed over: there is nothing to wait for.
    bool hasPassedOver() const { return m_has_passed_over; }
    /// Whether that frame was there already, whole.
    bool hasKept(int frame) const { return m_kept.has(frame); }
    /// The frame that a file is the picture of.
    std::optional<int> frameOf(const std::filesystem::path& file) const;

    /// Whether a picture or the page may be written; why not was told. Files that are not the
    /// recording's always may. Takes the file's folder if none was begun.
    bool mayWrite(const std::filesystem::path& file);
    /// To be called after a picture or the page was written.
    /// @return the number of the frame, from 0, that the file is the picture of; else nothing
    std::optional<int> fileWritten(const std::filesystem::path& file);
    /// To be called with what is known of that frame: notes it in the journal. Where that cannot be
    /// written the recording ends, which is told.
    void note(ManifestFrame frame);

    /// To be called again and again, also between the frames: now and then renews the journal.
    void beat();

    /// Looks what there is, and notes that the recording has ended.
    /// @return nothing where it never began in a folder
    std::optional<RecordingReport> end();

    /// Frames that it makes sure of.
    int wantedFrames() const { return m_wanted.count(); }

private:
    enum class State { waiting, running, refused };
    enum class Need { to_make, not_asked_for, kept, elsewhere };
    using Clock = std::chrono::steady_clock;

    bool isPage(const std::filesystem::path& file) const;
    bool isInPlace(const std::filesystem::path& file) const;
    void refuse(const std::string& why);
    bool isWhole() const { return !m_plan.choice.frames; }

    bool openJournal();
    std::optional<FrameClaim> claimBeginning();
    Result<void> start();
    Result<void> startAnew();
    std::optional<ProcessIdentity> otherWriter() const;
    void join(RecordingFile there);
    void tellStart();
    bool isAnyThere() const;
    FrameClaim::Claimer claimer();
    bool isAlive(const std::string& journal);

    Need needOf(int frame);
    Need decide(int frame);
    bool isKept(int frame);
    bool hasAllSoFar() const { return m_elsewhere.isEmpty(); }

    bool isStillOurs();
    void renew();
    void store() const;
    void lookThroughFolder(RecordingReport& report);
    bool keepIfOf(const PicturesByExtension& earlier, const std::string& name);
    void noteEnd();
    void endPart();
    void endWhole();
    bool writeManifest();
    FramesManifest manifest() const;
    void removeEndedJournals();
    void removeDeadClaims();

    RecordingPlan m_plan;
    Listener m_listener;
    Pace m_pace;
    State m_state = State::waiting;
    RecordingPlace m_place;
    std::filesystem::path m_parent; ///< the folder as the parent path of its files reads
    RecordingFile m_file;
    FrameSet m_wanted;
    std::optional<JournalWriter> m_journal;
    std::optional<KnownFrames> m_known;
    bool m_owned_page = false; ///< before this recording
    bool m_page_is_written = false;
    std::string m_trouble; ///< why it was refused

    int m_next = 0; ///< the frame that comes next
    std::optional<std::pair<int, Need>> m_decided;
    std::optional<FrameClaim> m_claim;
    Clock::time_point m_frame_start;
    bool m_has_passed_over = false;
    FrameSet m_made;
    FrameSet m_kept;
    FrameSet m_elsewhere;
    Clock::time_point m_next_beat;
};

} // namespace quarn
