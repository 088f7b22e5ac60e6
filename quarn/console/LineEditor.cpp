#include "quarn/console/LineEditor.h"

#include "quarn/console/PromptText.h"
#include "quarn/terminal/Columns.h"
#include "quarn/terminal/ShownText.h"
#include "quarn/terminal/Utf8Scope.h"
#include "quarn/words/Words.h"

#include <csignal>
#include <cstdio>
#include <sys/ioctl.h>
#include <unistd.h>

namespace quarn::program {

namespace {

constexpr int LINES_KEPT = 1000;
constexpr std::size_t MOST_SHOWN = 100; ///< of the completions that are left
constexpr int NARROWEST_TERMINAL = 20;

/// Whether the terminal was resized, or the program stopped and continued, so that what it shows is
/// no longer what the editor believes. Global, because a signal handler reaches nothing else.
volatile std::sig_atomic_t g_is_screen_stale = 0;

extern "C" void noteStaleScreen(int) {
    g_is_screen_stale = 1;
}

void watchScreen() {
    struct sigaction action = {};
    action.sa_handler = noteStaleScreen;
    action.sa_flags = SA_RESTART;
    sigemptyset(&action.sa_mask);
    sigaction(SIGWINCH, &action, nullptr);
    sigaction(SIGCONT, &action, nullptr);
}

void refreshScreen(EditLine* editor) {
    g_is_screen_stale = 0;
    el_set(editor, EL_PREP_TERM, 0); // whoever ran meanwhile may have changed the terminal
    el_set(editor, EL_PREP_TERM, 1);
    el_resize(editor);
    el_set(editor, EL_REFRESH);
}

std::size_t terminalWidth() {
    winsize size{};
    const bool is_known = ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0;
    return is_known && size.ws_col >= NARROWEST_TERMINAL ? size.ws_col : 80;
}

/// The editor draws what it knows again and again, so it is to know one line only.
/// @return the last line of the prompt
std::wstring showAllButLastLine(const std::wstring& prompt) {
    const std::size_t last_begin = prompt.rfind(L'\n') + 1; // 0 where there is one line
    std::fputs(utf8Text(prompt.substr(0, last_begin)).c_str(), stdout);
    return prompt.substr(last_begin);
}

std::wstring_view withoutLineBreak(std::wstring_view line) {
    while (line.ends_with(L'\n') || line.ends_with(L'\r'))
        line.remove_suffix(1);
    return line;
}

HistoryW* makeHistory() {
    HistoryW* const history = history_winit();
    HistEventW event;
    history_w(history, &event, H_SETSIZE, LINES_KEPT);
    history_w(history, &event, H_SETUNIQUE, 1);
    return history;
}

} // namespace

LineEditor::LineEditor() : m_commands(makeHistory()), m_answers(makeHistory()) {
    const Utf8Scope utf8;
    m_editor.reset(el_init("quarn", stdin, stdout, stderr));
    EditLine* const editor = m_editor.get();
    el_wset(editor, EL_CLIENTDATA, this);
    el_wset(editor, EL_PROMPT, &LineEditor::promptOf);
    el_wset(editor, EL_EDITOR, L"emacs");
    el_wset(editor, EL_SIGNAL, 0);
    el_wset(editor, EL_GETCFN, &LineEditor::readCharacter);
    el_wset(editor, EL_ADDFN, L"complete", L"Completes the word before the cursor",
            &LineEditor::completeHere);
    el_wset(editor, EL_BIND, L"^I", L"complete", nullptr);
    el_wset(editor, EL_BIND, L"^R", L"em-inc-search-prev", nullptr);
    watchScreen();
}

LineRead LineEditor::read(const std::wstring& prompt, LineUse use, const Completer& completer) {
    const Utf8Scope utf8;
    EditLine* const editor = m_editor.get();
    m_prompt = showAllButLastLine(wrappedPrompt(shownText(prompt), terminalWidth()));
    m_completer = &completer;
    m_is_interrupted = false;
    g_is_screen_stale = 0;
    el_wset(editor, EL_HIST, history_w, historyOf(use));
    el_resize(editor);
    std::fflush(stdout);
    // Else the prompt is seen a moment before the terminal is ready: a Ctrl-D then would be lost.
    el_set(editor, EL_PREP_TERM, 1);

    int length = 0;
    const wchar_t* const line = el_wgets(editor, &length);
    m_completer = nullptr;
    if (line && length > 0 && !m_is_interrupted)
        return {LineRead::Kind::line, std::wstring(withoutLineBreak(line))};
    std::fputs(m_is_interrupted ? "^C\n" : "\n", stdout);
    std::fflush(stdout);
    if (m_is_terminal_lost)
        return {LineRead::Kind::lost, {}};
    return {m_is_interrupted ? LineRead::Kind::interrupted : LineRead::Kind::end, {}};
}

void LineEditor::remember(std::wstring_view line, LineUse use) {
    HistEventW event;
    history_w(historyOf(use), &event, H_ENTER, std::wstring(line).c_str());
}

HistoryW* LineEditor::historyOf(LineUse use) const {
    return use == LineUse::command ? m_commands.get() : m_answers.get();
}

LineEditor& LineEditor::of(EditLine* editor) {
    void* self = nullptr;
    el_wget(editor, EL_CLIENTDATA, &self);
    return *static_cast<LineEditor*>(self);
}

wchar_t* LineEditor::promptOf(EditLine* editor) {
    return of(editor).m_prompt.data();
}

// ---- Input

bool LineEditor::readByte(unsigned char& byte) {
    for (;;) {
        const InputByte input = waitForByte(STDIN_FILENO);
        if (g_is_screen_stale != 0)
            refreshScreen(m_editor.get());
        m_is_interrupted = input.kind == InputByte::Kind::interrupted;
        m_is_terminal_lost = input.kind == InputByte::Kind::end; // Ctrl-D is a byte
        byte = input.byte;
        if (input.kind != InputByte::Kind::woken)
            return input.kind == InputByte::Kind::byte;
    }
}

/// Reads the rest of a character in UTF-8; what is none becomes the replacement character.
bool LineEditor::readTail(unsigned char first, wchar_t& character) {
    std::string bytes(1, static_cast<char>(first));
    const int tail_length = first >= 0xF0 ? 3 : first >= 0xE0 ? 2 : first >= 0xC0 ? 1 : 0;
    for (int i = 0; i < tail_length; ++i) {
        unsigned char byte = 0;
        if (!readByte(byte))
            return false;
        bytes += static_cast<char>(byte);
    }
    character = *wideText(bytes).c_str();
    return true;
}

int LineEditor::readCharacter(EditLine* editor, wchar_t* character) {
    unsigned char byte = 0;
    return of(editor).readByte(byte) && of(editor).readTail(byte, *character) ? 1 : 0;
}

// ---- Completion

unsigned char LineEditor::completeHere(EditLine* editor, wint_t) {
    return of(editor).complete();
}

unsigned char LineEditor::complete() {
    const LineInfoW* const line = el_wline(m_editor.get());
    const std::wstring_view typed(line->buffer,
                                  static_cast<std::size_t>(line->cursor - line->buffer));
    const Completion completion = (*m_completer)(typed);
    if (completion.candidates.empty())
        return CC_REFRESH_BEEP;
    const std::wstring_view word = typed.substr(completion.begin);
    const bool is_unique = completion.candidates.size() == 1;
    const std::wstring text =
        completion.commonText() + (is_unique ? completion.candidates.front().ending : L"");
    if (!is_unique && text.size() <= word.size()) {
        showCandidates(completion);
        return CC_NORM;
    }
    el_wdeletestr(m_editor.get(), static_cast<int>(word.size()));
    return el_winsertstr(m_editor.get(), text.c_str()) == 0 ? CC_REFRESH : CC_REFRESH_BEEP;
}

void LineEditor::showCandidates(const Completion& completion) const {
    std::vector<std::wstring> names;
    for (const Completion::Candidate& candidate : completion.candidates) {
        if (names.size() < MOST_SHOWN)
            names.push_back(shownText(candidate.shown));
    }
    std::string text = inColumns(names, terminalWidth());
    if (const std::size_t more = completion.candidates.size() - names.size())
        text += "and " + std::to_string(more) + " more\n";
    std::fputs("\n", stdout);
    std::fwrite(text.data(), 1, text.size(), stdout);
    std::fflush(stdout);
    el_set(m_editor.get(), EL_REFRESH); // draws the line anew, below; CC_REDISPLAY goes up first
}

} // namespace quarn::program
