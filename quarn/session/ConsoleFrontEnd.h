#pragma once

#include "host/front_end/FrontEnd.h"
#include "quarn/session/RecordingText.h"
#include "quarn/terminal/FramePace.h"
#include "quarn/terminal/ProgressLine.h"

#include <string>
#include <vector>

namespace quarn::program {

/// The front end of a program that nobody answers: it shows what it is told to show, keeps the last
/// words of the host for error messages, and shows how far a recording is.
class ConsoleFrontEnd : public FrontEnd {
public:
    enum class Prints {
        hidden, ///< only remembered
        shown,  ///< on the standard output
    };
    explicit ConsoleFrontEnd(Prints prints);

    /// Shows what the program is busy with, where a person can see it go away again.
    void showStep(std::string_view text) { m_progress.show(text); }
    void clearProgress() { m_progress.clear(); }
    /// Makes what is shown next begin a line.
    void endLine();

    /// A recording of this many pictures begins: counts from 0 again, and forgets the last words.
    void beginRecording(int frames);
    /// Whether it began in its folder since then: else the host refused it.
    bool hasRecordingBegun() const { return m_has_begun; }
    int framesWritten() const { return m_frames_written; }
    /// The recordings that have ended, in their order.
    const std::vector<EndedRecording>& recordings() const { return m_recordings; }

    /// What was made of recordings for others, or could not be.
    const std::vector<SharedFileReport>& sharedFiles() const { return m_shared_files; }
    /// What the newest of them holds; empty before the first.
    std::string lastSharedText() const;

    /// The last line that the host printed since forgetLastWords; UTF-8, empty when there is none.
    /// During a recording: since the last picture.
    std::string lastWords() const;
    /// The last two lines, as one: the host tells why an answer cannot be taken, and then the
    /// command how it ends.
    std::string closingWords() const;
    void forgetLastWords();

    /// From now on everything that is printed is shown.
    void showWords() { m_prints = Prints::shown; }
    bool hidesWords() const { return m_prints == Prints::hidden; }
    /// From now on what is printed is kept, and not shown.
    void keepWords() { m_keeps_words = true; }
    /// What was kept; from now on nothing is.
    std::string takeKeptWords();

    void print(std::wstring_view text) override;
    void warn(std::wstring_view text) override;
    Answer ask(const Question& question) override;
    int showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) override;
    std::optional<std::filesystem::path>
    chooseFolder(std::wstring_view title, std::wstring_view message,
                 const std::filesystem::path& start_folder) override;
    void pumpEvents(unsigned milliseconds) override;
    bool isKeyDown(int virtual_key) override;
    bool isInterrupted() const override;
    HWND mainWindow() override;
    void recordingBegun(const RecordingStart& start) override;
    void frameWritten(const std::filesystem::path& file, int written, int total) override;
    void recordingEnded(const RecordingReport& report) override;
    void sharedFileProgress(const std::filesystem::path& file, double share) override;
    void sharedFileEnded(const SharedFileReport& report) override;
    void pictureRendered(double share) override;
    void modelRead(const std::filesystem::path& file, ModelStep step, double share) override;

private:
    void rememberWords(std::string_view text);
    bool isProgressDue();

    Prints m_prints;
    ProgressLine m_progress;
    FramePace m_pace;
    FramePace::Clock::time_point m_next_progress;
    std::string m_last_line;
    std::string m_line_before; ///< the last one
    std::string m_open_line;   ///< printed so far without a line break
    bool m_keeps_words = false;
    std::string m_kept_words;
    bool m_is_inside_line = false; ///< the last text shown did not end its line
    bool m_has_begun = false;
    int m_frames_written = 0;
    int m_frames_expected = 0;
    std::vector<EndedRecording> m_recordings;
    std::vector<SharedFileReport> m_shared_files;
};

} // namespace quarn::program
