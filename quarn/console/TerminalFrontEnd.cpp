#include "quarn/console/TerminalFrontEnd.h"

#include "quarn/console/PromptText.h"
#include "quarn/console/TypedPlace.h"
#include "quarn/session/Interruption.h"
#include "sdk/qncore/QnPlatform.h"

namespace quarn::program {

namespace {

void trim(std::wstring& text) {
    constexpr const wchar_t* BLANKS = L" \t";
    const std::size_t first = text.find_first_not_of(BLANKS);
    text.erase(0, first);
    text.erase(text.find_last_not_of(BLANKS) + 1);
}

} // namespace

LineRead TerminalFrontEnd::readLine(const std::wstring& prompt, LineUse use,
                                    const Completer& completer) {
    endLine();
    LineRead read = m_lines.read(prompt, use, completer);
    trim(read.text);
    if (!read.text.empty())
        m_lines.remember(read.text, use);
    return read;
}

/// Ctrl-C is Escape here; so is the end of input where a person can give other answers later.
Answer TerminalFrontEnd::ask(const Question& question) {
    const Completer completer = [&](std::wstring_view typed) {
        return completeAnswer(typed, question);
    };
    LineRead read = readLine(promptText(question), LineUse::answer, completer);
    if (read.kind == LineRead::Kind::line)
        return {Answer::Kind::text, std::wstring_view(read.text)};
    if (read.kind == LineRead::Kind::end && !m_lines.isTerminal()) {
        endLine();
        return {};
    }
    if (read.kind == LineRead::Kind::interrupted)
        forgetCtrlC();
    return {Answer::Kind::cancel, {}};
}

std::optional<std::filesystem::path>
TerminalFrontEnd::chooseFolder(std::wstring_view title, std::wstring_view,
                               const std::filesystem::path& start_folder) {
    Question question;
    question.kind = Question::Kind::string;
    question.prompt = title;
    question.default_answer = KM_wString::FromUtf8(start_folder.native());
    const Answer answer = ask(question);
    if (answer.kind != Answer::Kind::text)
        return std::nullopt;
    return answer.text.IsEmpty() ? start_folder : std::filesystem::path(answer.text.ToUtf8());
}

std::optional<Place> TerminalFrontEnd::chooseLocation(std::wstring_view title, const Place& start) {
    Question question;
    question.kind = Question::Kind::string;
    question.prompt = KM_wString(title) + L" (city, or latitude and longitude)";
    question.default_answer = KM_wString(std::wstring_view(textFromPlace(start)));
    for (;;) {
        const Answer answer = ask(question);
        if (answer.kind != Answer::Kind::text)
            return std::nullopt;
        if (answer.text.IsEmpty())
            return start;
        const auto typed = placeFromText(answer.text.View());
        if (const Place* const place = std::get_if<Place>(&typed))
            return *place;
        print(std::get<std::wstring>(typed) + L"\n");
    }
}

/// A person who wants an end of it need not wait.
void TerminalFrontEnd::pumpEvents(unsigned milliseconds) {
    if (!isInterruptionRequested())
        ConsoleFrontEnd::pumpEvents(milliseconds);
}

/// A terminal tells no key that is held down; Ctrl-C is Escape to whoever watches for it.
bool TerminalFrontEnd::isKeyDown(int virtual_key) {
    return virtual_key == VK_ESCAPE && isInterruptionRequested();
}

} // namespace quarn::program
