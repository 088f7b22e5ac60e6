// A line that a person or a script gives: split into words, read as a command line, and every word
// read as what a prompt may take it for. The text is taken as UTF-8, as in a script file.
#include "host/app/CommandLine.h"
#include "host/commands/PointText.h"
#include "host/prompt/NumberText.h"
#include "host/prompt/OptionPick.h"
#include "host/prompt/PromptAnswer.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace {

using namespace quarn;

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

std::wstring inQuotes(std::wstring_view word) {
    return L'"' + std::wstring(word) + L'"';
}

// ---- Words and command lines

std::wstring lineOf(const std::deque<CommandWord>& words) {
    std::wstring line;
    for (const CommandWord& word : words)
        line += L' ' + inQuotes(word.text);
    return line;
}

void requireSameTexts(const std::deque<CommandWord>& words, const std::deque<CommandWord>& others) {
    require(std::ranges::equal(words, others, {}, &CommandWord::text, &CommandWord::text));
}

std::deque<CommandWord> checkSplitting(std::wstring_view text) {
    const Result<std::deque<CommandWord>> split = splitWords(text);
    require(split.ok() == (std::ranges::count(text, L'"') % 2 == 0));
    if (!split) {
        require(!split.message().empty());
        return {};
    }
    for (const CommandWord& word : split.value()) {
        require(word.text.find(L'"') == std::wstring::npos);
        require(word.quoted || !word.text.empty());
    }
    const Result<std::deque<CommandWord>> again = splitWords(lineOf(split.value()));
    require(again.ok());
    requireSameTexts(split.value(), again.value());
    require(std::ranges::all_of(again.value(), &CommandWord::quoted));
    return split.value();
}

void checkCommandLine(std::wstring_view text, std::size_t word_count) {
    const Result<CommandLine> parsed = parseCommandLine(text);
    if (!parsed) {
        require(!parsed.message().empty());
        return;
    }
    const CommandLine& line = parsed.value();
    require(line.words.size() + (line.isBlank() ? 0 : 1) <= word_count);
    if (line.isBlank()) {
        require(line.words.empty());
        return;
    }
    require(line.name.find_first_of(L"_-!") != 0);
    const std::wstring prefixes =
        std::wstring(line.english_name ? L"_" : L"") + (line.without_dialogs ? L"-" : L"");
    const Result<CommandLine> again =
        parseCommandLine(prefixes + inQuotes(line.name) + lineOf(line.words));
    require(again.ok());
    require(again.value().name == line.name);
    require(again.value().english_name == line.english_name);
    require(again.value().without_dialogs == line.without_dialogs);
    requireSameTexts(again.value().words, line.words);
}

// ---- Numbers and points

bool isSame(double a, double b) {
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

void checkNumber(std::wstring_view word) {
    const std::optional<double> number = readNumber(word);
    if (number) {
        require(std::isfinite(*number));
        const std::optional<double> again = readNumber(numberText(*number).View());
        require(again && isSame(*again, *number));
    }
    if (const std::optional<int> whole = readWholeNumber(word)) {
        require(number && *number == *whole);
        require(readWholeNumber(numberText(*whole).View()) == whole);
    }
}

void checkNumberOfBits(std::uint64_t bits) {
    const auto number = std::bit_cast<double>(bits);
    const std::optional<double> read = readNumber(numberText(number).View());
    require(read.has_value() == std::isfinite(number));
    require(!read || isSame(*read, number));
}

void checkPoint(std::wstring_view word) {
    const Result<KM_3dPoint> point = readPoint(word);
    if (!point) {
        require(!point.message().empty());
        return;
    }
    require(point.value().IsValid());
    const Result<KM_3dPoint> again = readPoint(pointText(point.value()).View());
    require(again && again.value() == point.value());
}

// ---- Prompts

PromptState promptOf(Question::Kind kind) {
    PromptState prompt;
    prompt.kind = kind;
    prompt.lower_limit = -2.5;
    prompt.upper_limit = 100.0;
    prompt.addOption({{L"Frames", L"Bilder"}, std::nullopt, std::nullopt});
    prompt.addOption(
        {{L"Size", L"Größe"}, CQuarnCommandOptionValue{L"Large", L"Groß"}, std::nullopt});
    prompt.addOption({{L"Loop", L"Schleife"},
                      std::nullopt,
                      PromptOption::Toggle{{L"No", L"Nein"}, {L"Yes", L"Ja"}, false, nullptr}});
    return prompt;
}

bool isSame(const OptionPick& a, const OptionPick& b) {
    return a.kind == b.kind && a.index == b.index && a.turns_on == b.turns_on;
}

void checkOptions(std::wstring_view word) {
    const PromptState prompt = promptOf(Question::Kind::option);
    const OptionPick pick = readOption(prompt, word);
    if (pick.kind == OptionPick::Kind::none)
        require(pick.index == 0);
    else
        require(pick.index >= 1 && pick.index <= static_cast<int>(prompt.options.size()));
    if (pick.kind == OptionPick::Kind::bad_value)
        require(prompt.options[static_cast<std::size_t>(pick.index) - 1].toggle.has_value());
    const std::wstring text(word);
    require(isSame(readOptionClick(prompt, L'[' + text + L']'), pick));
    if (!word.starts_with(L'_') && pick.kind == OptionPick::Kind::picked)
        require(isSame(readOption(prompt, L'_' + text), pick));
}

void checkAnswer(Question::Kind kind, CQuarnGet::result result, std::wstring_view word,
                 bool literal) {
    PromptState prompt = promptOf(kind);
    const auto request = takeAnswer(prompt, {Answer::Kind::text, word}, literal);
    if (request) {
        require(!request->IsEmpty());
        require(prompt.result == CQuarnGet::no_result);
        return;
    }
    require(prompt.result == result || prompt.result == CQuarnGet::option);
    require(prompt.command_result == CQuarnCommand::success);
    if (prompt.result == CQuarnGet::number) {
        const double number = kind == Question::Kind::integer ? prompt.whole_number : prompt.number;
        require(number >= prompt.lower_limit && number <= prompt.upper_limit);
    }
    if (prompt.result == CQuarnGet::string)
        require(prompt.text == KM_wString(word));
}

void checkWord(std::wstring_view word, bool literal) {
    checkNumber(word);
    checkPoint(word);
    checkOptions(word);
    checkAnswer(Question::Kind::option, CQuarnGet::string, word, literal);
    checkAnswer(Question::Kind::string, CQuarnGet::string, word, literal);
    checkAnswer(Question::Kind::number, CQuarnGet::number, word, literal);
    checkAnswer(Question::Kind::integer, CQuarnGet::number, word, literal);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const KM_wString line = KM_wString::FromUtf8({reinterpret_cast<const char*>(bytes), size});
    const std::deque<CommandWord> words = checkSplitting(line.View());
    checkCommandLine(line.View(), words.size());
    checkWord(line.View(), false);
    for (const CommandWord& word : words)
        checkWord(word.text, word.quoted);

    std::uint64_t bits = 0;
    if (size > 0) // an empty input has no bytes to point to
        std::memcpy(&bits, bytes, std::min(size, sizeof bits));
    checkNumberOfBits(bits);
    return 0;
}
