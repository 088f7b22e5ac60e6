#pragma once

#include "host/front_end/FrontEnd.h"
#include "host/front_end/HeadlessDialogWindow.h"

#include <deque>
#include <string>
#include <utility>
#include <vector>

namespace quarn {

/// A front end without a person: it answers from a queue and records all that was said. With an
/// empty queue nobody answers.
class QNCORE_API ScriptedFrontEnd : public FrontEnd {
public:
    ScriptedFrontEnd();
    ~ScriptedFrontEnd() override;

    /// Queues the next answer: "_Enter" is Enter, "_Cancel" Escape, everything else that text.
    void addAnswer(std::wstring_view answer);
    /// Queues the next choice of chooseFolder; nothing stands for a closed chooser.
    void addFolderChoice(std::optional<std::filesystem::path> folder);
    /// Queues what a person does in the next dialog.
    void addDialog(HeadlessDialogWindow::Script script);
    /// Queues the next choice of chooseLocation; nothing stands for a closed chooser.
    void addLocationChoice(std::optional<Place> place);
    /// Queues the next choice of chooseFile.
    void addFileChoice(FileChoice choice);
    /// Holds a key down, or lets it go.
    void setKeyDown(int virtual_key, bool down);
    /// Asks the program to stop, as Ctrl-C does.
    void interrupt();

    /// All text printed so far.
    const std::wstring& printed() const;
    void clearPrinted();
    /// The questions asked so far, in their order.
    const std::vector<Question>& questions() const;
    struct Message {
        std::wstring text;
        std::wstring title;
        unsigned flags;
    };
    /// The messages shown so far.
    const std::vector<Message>& messages() const;
    /// The forms of the dialogs made so far, also of those that nobody answered.
    const std::vector<DialogTemplate>& dialogs() const;
    struct FolderQuestion {
        std::wstring title;
        std::wstring message;
        std::filesystem::path start_folder;
    };
    /// What chooseFolder was asked so far.
    const std::vector<FolderQuestion>& folderQuestions() const;
    struct LocationQuestion {
        std::wstring title;
        Place start;
    };
    /// What chooseLocation was asked so far.
    const std::vector<LocationQuestion>& locationQuestions() const;
    /// What chooseFile was asked so far.
    const std::vector<FileQuestion>& fileQuestions() const;
    /// What became of the recordings so far.
    const std::vector<RecordingReport>& recordings() const;
    /// How many milliseconds of waiting were asked for.
    unsigned long long waited_ms() const;

    void print(std::wstring_view text) override;
    Answer ask(const Question& question) override;
    int showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) override;
    std::optional<std::filesystem::path>
    chooseFolder(std::wstring_view title, std::wstring_view message,
                 const std::filesystem::path& start_folder) override;
    void pumpEvents(unsigned milliseconds) override; ///< sleeps for that long
    bool isKeyDown(int virtual_key) override;
    bool isInterrupted() const override;
    HWND mainWindow() override;
    void frameWritten(const std::filesystem::path& file, int written, int total) override;
    void recordingEnded(const RecordingReport& report) override;
    /// @return null when no script is queued
    std::unique_ptr<DialogWindow> makeDialog(const DialogTemplate& form, HWND owner) override;
    std::optional<Place> chooseLocation(std::wstring_view title, const Place& start) override;
    FileChoice chooseFile(const FileQuestion& question) override;

private:
    std::deque<Answer> m_answers;
    std::deque<std::optional<std::filesystem::path>> m_folder_choices;
    std::deque<HeadlessDialogWindow::Script> m_dialog_scripts;
    std::deque<std::optional<Place>> m_location_choices;
    std::deque<FileChoice> m_file_choices;
    std::vector<int> m_keys_down;
    std::wstring m_printed;
    std::vector<Question> m_questions;
    std::vector<Message> m_messages;
    std::vector<DialogTemplate> m_dialogs;
    std::vector<FolderQuestion> m_folder_questions;
    std::vector<LocationQuestion> m_location_questions;
    std::vector<FileQuestion> m_file_questions;
    std::vector<RecordingReport> m_recordings;
    unsigned long long m_waited_ms = 0;
    bool m_interrupted = false;
};

} // namespace quarn
