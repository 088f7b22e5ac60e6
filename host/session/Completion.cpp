#include "host/session/Completion.h"

#include "host/session/FileCompletion.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::wstring_view BLANKS = L" \t";
/// What may stand before a command's name; behind "_" it is the English one.
constexpr std::wstring_view PREFIXES = L"_-!";

std::size_t sharedLength(std::wstring_view first, std::wstring_view second) {
    std::size_t length = std::min(first.size(), second.size());
    while (length > 0 &&
           KM_wString(first.substr(0, length)).CompareNoCase(KM_wString(second.substr(0, length))))
        --length;
    return length;
}

bool startsWith(std::wstring_view text, std::wstring_view start) {
    return sharedLength(text, start) == start.size();
}

/// Adds a name that begins with what was typed, once.
void addName(Completion& completion, std::wstring_view typed, std::wstring_view name,
             const std::wstring& text, const std::wstring& ending) {
    const auto is_there = [&](const Completion::Candidate& other) { return other.shown == name; };
    if (startsWith(name, typed) && std::ranges::none_of(completion.candidates, is_there))
        completion.candidates.push_back({text, std::wstring(name), ending});
}

/// @param typed  the name so far, with its prefixes
Completion completeName(std::wstring_view typed, const std::vector<CommandName>& names) {
    const std::size_t name_begin = std::min(typed.find_first_not_of(PREFIXES), typed.size());
    const std::wstring prefixes(typed.substr(0, name_begin));
    const std::wstring_view start = typed.substr(name_begin);
    const bool is_english = prefixes.find(L'_') != std::wstring::npos;
    Completion completion;
    for (const CommandName& name : names) {
        for (const KM_wString& spelling : {is_english ? name.english : name.local, name.english})
            addName(completion, start, spelling.View(), prefixes + spelling.Array(), L" ");
    }
    return completion;
}

/// Where the last word of a line begins; blanks in double quotes end none.
std::size_t lastWordBegin(std::wstring_view line) {
    std::size_t begin = 0;
    bool is_quoted = false;
    for (std::size_t i = 0; i < line.size(); ++i) {
        is_quoted ^= line[i] == L'"';
        if (!is_quoted && BLANKS.find(line[i]) != BLANKS.npos)
            begin = i + 1;
    }
    return begin;
}

void addOptions(Completion& completion, std::wstring_view typed, const Question& question) {
    const bool is_english = typed.starts_with(L'_') || typed.starts_with(L"[_");
    for (const QuestionOption& option : question.options) {
        std::wstring name(is_english ? option.english_name.View() : option.local_name.View());
        if (is_english)
            name.insert(name.begin(), L'_');
        const std::wstring text = optionText(question.kind, name);
        addName(completion, typed, text, text, L"");
    }
}

} // namespace

std::wstring Completion::commonText() const {
    std::wstring_view common = candidates.empty() ? std::wstring_view() : candidates.front().text;
    for (const Candidate& candidate : candidates)
        common = common.substr(0, sharedLength(common, candidate.text));
    return std::wstring(common);
}

Completion completeCommand(std::wstring_view typed, const std::vector<CommandName>& names) {
    const std::size_t begin = lastWordBegin(typed);
    const bool is_first_word = typed.substr(0, begin).find_first_not_of(BLANKS) == typed.npos;
    const std::wstring_view word = typed.substr(begin);
    Completion completion = is_first_word ? completeName(word, names) : completeFile(word, true);
    completion.begin = begin;
    return completion;
}

Completion completeAnswer(std::wstring_view typed, const Question& question) {
    Completion completion;
    addOptions(completion, typed, question);
    for (const KM_wString& name : question.object_names)
        addName(completion, typed, name.View(), std::wstring(name.View()), L"");
    const bool takes_text =
        question.kind == Question::Kind::string || question.kind == Question::Kind::option;
    if (completion.candidates.empty() && takes_text)
        return completeFile(typed, false);
    return completion;
}

std::wstring optionText(Question::Kind kind, std::wstring_view inside) {
    const bool is_text_question = kind == Question::Kind::string;
    return is_text_question ? L'[' + std::wstring(inside) + L']' : std::wstring(inside);
}

} // namespace quarn
