#pragma once

#include "host/front_end/FrontEnd.h"

#include <deque>
#include <string>
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

private:
    std::deque<Answer> m_answers;
    std::deque<std::optional<std::filesystem::path>> m_folder_choices;
    std::vector<int> m_keys_down;
    std::wstring m_printed;
    std::vector<Question> m_questions;
    std::vector<Message> m_messages;
    unsigned long long m_waited_ms = 0;
    bool m_interrupted = false;
};

} // namespace quarn
