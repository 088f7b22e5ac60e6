#pragma once

#include "quarn/console/LineSource.h"

#include <histedit.h>
#include <memory>

namespace quarn::program {

/// Lines that a person types at a terminal, with editing, completion by Tab, and earlier lines by
/// Up and Down.
class LineEditor final : public LineSource {
public:
    /// The standard input and output are the terminal.
    LineEditor();
    LineEditor(const LineEditor&) = delete;
    LineEditor& operator=(const LineEditor&) = delete;

    LineRead read(const std::wstring& prompt, LineUse use, const Completer& completer) override;
    void remember(std::wstring_view line, LineUse use) override;
    bool isTerminal() const override { return true; }

private:
    struct EditorEnd {
        void operator()(EditLine* editor) const { el_end(editor); }
    };
    struct HistoryEnd {
        void operator()(HistoryW* history) const { history_wend(history); }
    };
    using History = std::unique_ptr<HistoryW, HistoryEnd>;

    static LineEditor& of(EditLine* editor);
    static wchar_t* promptOf(EditLine* editor);
    static int readCharacter(EditLine* editor, wchar_t* character);
    static unsigned char completeHere(EditLine* editor, wint_t key);

    HistoryW* historyOf(LineUse use) const;
    bool readTail(unsigned char first, wchar_t& character);
    bool readByte(unsigned char& byte);
    unsigned char complete();
    void showCandidates(const Completion& completion) const;

    History m_commands;
    History m_answers;
    std::wstring m_prompt;
    const Completer* m_completer = nullptr;
    bool m_is_interrupted = false;
    bool m_is_terminal_lost = false;
    std::unique_ptr<EditLine, EditorEnd> m_editor; // goes first: it looks into the rest
};

} // namespace quarn::program
