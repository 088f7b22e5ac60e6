#pragma once

#include "host/front_end/RecordingReport.h"
#include "host/recording/RecordingPlace.h"

#include <chrono>
#include <functional>
#include <optional>

namespace quarn {

/// A recording of a whole animation while its command runs: it takes the folder, decides which
/// files may be written there, keeps its NAME.recording alive and counts what was written.
class RunningRecording {
public:
    /// How often NAME.recording is renewed, and for how long it holds without that: long enough for
    /// the slowest drawing of a scene and for clocks that differ a little.
    struct Pace {
        std::chrono::seconds beat{5};
        std::chrono::seconds lease{60};
    };
    struct Plan {
        std::string animation; ///< its name, UTF-8
        RecordingSettings settings;
        bool overwrites = false; ///< files of others may be replaced
    };
    /// Shows a person a sentence in UTF-8.
    using Tell = std::function<void(const std::string&)>;

    RunningRecording(Plan plan, Tell tell);
    RunningRecording(Plan plan, Tell tell, Pace pace);

    /// The folder is there, and the pictures come next. Only the first folder counts.
    /// @return false, told once, where the recording may not take place there
    bool begin(const std::filesystem::path& folder);

    /// Whether a picture or the page may be written; why not was told. Files that are not the
    /// recording's always may. Takes the file's folder if none was begun.
    bool mayWrite(const std::filesystem::path& file);
    /// To be called after a picture or the page was written.
    /// @return the number of the frame, from 0, that the file is the picture of; else nothing
    std::optional<int> fileWritten(const std::filesystem::path& file);

    /// To be called again and again, also between the frames: now and then renews NAME.recording.
    void beat();

    /// Looks what there is, and notes in NAME.recording that the recording has ended.
    /// @return nothing where it never began in a folder
    std::optional<RecordingReport> end();

private:
    enum class State { waiting, running, refused };

    std::optional<int> frameOf(const std::filesystem::path& file) const;
    bool isPage(const std::filesystem::path& file) const;
    bool isInPlace(const std::filesystem::path& file) const;
    void refuse(const std::string& why);
    bool isStillOurs();
    void renew();
    void store() const;
    void lookThroughFolder(RecordingReport& report);
    bool keepIfOf(const PicturesByExtension& earlier, const std::string& name);
    void noteEnd();

    Tell m_tell;
    Pace m_pace;
    bool m_overwrites;
    State m_state = State::waiting;
    RecordingPlace m_place;
    std::filesystem::path m_parent; ///< the folder as the parent path of its files reads
    RecordingFile m_file;
    bool m_owned_page = false; ///< before this recording
    bool m_page_is_written = false;
    int m_written = 0;
    std::chrono::steady_clock::time_point m_next_beat;
};

} // namespace quarn
