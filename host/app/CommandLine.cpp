#include "host/app/CommandLine.h"

#include "kelmar/KM_wString.h"

namespace quarn {

namespace {

bool isBlankCharacter(wchar_t character) {
    return character == L' ' || character == L'\t' || character == L'\r' || character == L'\n';
}

/// Reads the word at `position` and moves it behind the word. False when a quote is not closed.
bool readWord(std::wstring_view text, std::size_t& position, CommandWord& word) {
    word.quoted = text[position] == L'"';
    bool inside_quotes = false;
    for (; position < text.size(); ++position) {
        const wchar_t character = text[position];
        if (character == L'"')
            inside_quotes = !inside_quotes;
        else if (!inside_quotes && isBlankCharacter(character))
            break;
        else
            word.text += character;
    }
    return !inside_quotes;
}

/// Whether a word is "!" alone.
bool isSeparator(const CommandWord& word) {
    return !word.text.empty() && word.text.find_first_not_of(L'!') == std::wstring::npos;
}

Error nameMissing(std::wstring_view line) {
    return Error{"No command name in: " + KM_wString(line).ToUtf8()};
}

} // namespace

Result<std::deque<CommandWord>> splitWords(std::wstring_view text) {
    std::deque<CommandWord> words;
    std::size_t position = 0;
    while (position < text.size()) {
        if (isBlankCharacter(text[position])) {
            ++position;
            continue;
        }
        CommandWord word;
        if (!readWord(text, position, word))
            return Error{"A double quote is not closed in: " + KM_wString(text).ToUtf8()};
        words.push_back(std::move(word));
    }
    return words;
}

Result<CommandLine> parseCommandLine(std::wstring_view line) {
    Result<std::deque<CommandWord>> split = splitWords(line);
    if (!split)
        return split.error();
    CommandLine parsed;
    parsed.words = std::move(split.value());
    while (!parsed.words.empty() && isSeparator(parsed.words.front()))
        parsed.words.pop_front();
    if (parsed.words.empty())
        return parsed;

    const std::wstring first = parsed.words.front().text;
    parsed.words.pop_front();
    const std::size_t name_begin = first.find_first_not_of(L"_-!");
    if (name_begin == std::wstring::npos)
        return nameMissing(line);
    const std::wstring_view prefixes = std::wstring_view(first).substr(0, name_begin);
    parsed.english_name = prefixes.find(L'_') != prefixes.npos;
    parsed.without_dialogs = prefixes.find(L'-') != prefixes.npos;
    parsed.name = first.substr(name_begin);
    return parsed;
}

} // namespace quarn
