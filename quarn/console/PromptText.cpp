#include "quarn/console/PromptText.h"

#include "host/session/Completion.h"
#include "quarn/terminal/TextWidth.h"

#include <algorithm>

namespace quarn::program {

namespace {

std::wstring shownOption(Question::Kind kind, const QuestionOption& option) {
    std::wstring inside(option.local_name.View());
    if (!option.value.IsEmpty())
        inside.append(L"=").append(option.value.View());
    return optionText(kind, inside);
}

/// Room to type behind a prompt: most answers are shorter, and a line of answers may wrap.
constexpr std::size_t ROOM_TO_TYPE = 24;
constexpr std::wstring_view INDENT = L"\n  ";

} // namespace

std::wstring promptText(const Question& question) {
    std::wstring text(question.prompt.View());
    if (question.default_answer && !question.default_answer->IsEmpty())
        text.append(L" <").append(question.default_answer->View()).append(L">");
    if (!question.options.empty()) {
        text += L" (";
        for (const QuestionOption& option : question.options)
            text += L' ' + shownOption(question.kind, option);
        text += L" )";
    }
    return text + L": ";
}

std::wstring wrappedPrompt(const std::wstring& prompt, std::size_t width) {
    const std::size_t room = width > 2 * ROOM_TO_TYPE ? width - ROOM_TO_TYPE : width;
    if (textWidth(prompt) <= room)
        return prompt;
    std::wstring wrapped;
    std::size_t column = 0;
    for (std::size_t begin = 0; begin < prompt.size();) {
        const std::size_t end = std::min(prompt.find(L' ', begin), prompt.size() - 1) + 1;
        const std::wstring_view word = std::wstring_view(prompt).substr(begin, end - begin);
        if (column > 0 && column + textWidth(word) > room) {
            wrapped += INDENT;
            column = INDENT.size() - 1;
        }
        wrapped += word;
        column += textWidth(word);
        begin = end;
    }
    return wrapped;
}

} // namespace quarn::program
