#include "host/prompt/PromptAnswer.h"

#include "host/prompt/NumberText.h"
#include "host/prompt/ObjectAnswer.h"
#include "host/prompt/OptionPick.h"

#include <limits>

namespace quarn {

namespace {

using Refusal = std::optional<KM_wString>;

Refusal endWith(PromptState& prompt, CQuarnGet::result result) {
    prompt.result = result;
    if (result == CQuarnGet::cancel)
        prompt.objects.ids.clear();
    prompt.command_result =
        result == CQuarnGet::cancel ? CQuarnCommand::cancel : CQuarnCommand::success;
    return std::nullopt;
}

Refusal pick(PromptState& prompt, const OptionPick& picked) {
    PromptOption& option = prompt.options[static_cast<std::size_t>(picked.index) - 1];
    if (option.toggle) {
        option.toggle->is_on = picked.turns_on;
        if (option.toggle->variable)
            *option.toggle->variable = picked.turns_on;
    }
    prompt.picked.m_option_index = picked.index;
    return endWith(prompt, CQuarnGet::option);
}

KM_wString requestValue(const PromptOption& option) {
    return L"Enter " + option.name.m_local + L"=" + option.toggle->off.m_local + L" or " +
           option.name.m_local + L"=" + option.toggle->on.m_local;
}

// ---- Numbers

/// "Enter a number from 1 to 12", and the like where there is one limit or none.
KM_wString requestNumber(const wchar_t* what, double lower, double upper) {
    const KM_wString request = KM_wString(L"Enter ") + what;
    if (lower != KM_UNSET_VALUE && upper != KM_UNSET_VALUE)
        return request + L" from " + numberText(lower) + L" to " + numberText(upper);
    if (lower != KM_UNSET_VALUE)
        return request + L" of at least " + numberText(lower);
    if (upper != KM_UNSET_VALUE)
        return request + L" of at most " + numberText(upper);
    return request;
}

bool isWithinLimits(const PromptState& prompt, double number) {
    return (prompt.lower_limit == KM_UNSET_VALUE || number >= prompt.lower_limit) &&
           (prompt.upper_limit == KM_UNSET_VALUE || number <= prompt.upper_limit);
}

Refusal takeNumber(PromptState& prompt, const KM_wString& text) {
    const std::optional<double> number = readNumber(text.View());
    if (!number || !isWithinLimits(prompt, *number))
        return requestNumber(L"a number", prompt.lower_limit, prompt.upper_limit);
    prompt.number = *number;
    return endWith(prompt, CQuarnGet::number);
}

/// Asks for a whole number; names the limits of whole numbers where a number lies beyond them.
KM_wString requestWholeNumber(const PromptState& prompt, const KM_wString& text) {
    double lower = prompt.lower_limit;
    double upper = prompt.upper_limit;
    constexpr double least = std::numeric_limits<int>::min();
    constexpr double largest = std::numeric_limits<int>::max();
    const std::optional<double> number = readNumber(text.View());
    if (number && *number < least && lower == KM_UNSET_VALUE)
        lower = least;
    if (number && *number > largest && upper == KM_UNSET_VALUE)
        upper = largest;
    return requestNumber(L"a whole number", lower, upper);
}

Refusal takeWholeNumber(PromptState& prompt, const KM_wString& text) {
    const std::optional<int> number = readWholeNumber(text.View());
    if (!number)
        return requestWholeNumber(prompt, text);
    if (!isWithinLimits(prompt, *number))
        return requestNumber(L"a number", prompt.lower_limit, prompt.upper_limit);
    prompt.whole_number = *number;
    return endWith(prompt, CQuarnGet::number);
}

// ---- Objects

/// Takes one object; the question ends with the last one that is wanted.
Refusal takeNextObject(PromptState& prompt, const KM_wString& text) {
    Refusal refusal = takeObject(prompt.objects, text);
    if (!refusal && prompt.objects.isFull())
        return endWith(prompt, CQuarnGet::object);
    return refusal;
}

/// Enter after some objects were given.
Refusal endObjects(PromptState& prompt) {
    if (prompt.objects.isEnough())
        return endWith(prompt, CQuarnGet::object);
    return KM_wString::FormatToString(L"Pick at least %d objects",
                                      static_cast<int>(prompt.objects.minimum));
}

// ---- Any kind

OptionPick readPick(const PromptState& prompt, const KM_wString& text, bool literal) {
    if (prompt.kind == Question::Kind::string)
        return literal ? OptionPick{} : readOptionClick(prompt, text.View());
    if (prompt.kind == Question::Kind::object && literal)
        return {};
    return readOption(prompt, text.View());
}

Refusal takeText(PromptState& prompt, const KM_wString& text, bool literal) {
    const OptionPick picked = readPick(prompt, text, literal);
    if (picked.kind == OptionPick::Kind::picked)
        return pick(prompt, picked);
    if (picked.kind == OptionPick::Kind::bad_value)
        return requestValue(prompt.options[static_cast<std::size_t>(picked.index) - 1]);
    if (prompt.kind == Question::Kind::number)
        return takeNumber(prompt, text);
    if (prompt.kind == Question::Kind::integer)
        return takeWholeNumber(prompt, text);
    if (prompt.kind == Question::Kind::object)
        return takeNextObject(prompt, text);
    prompt.text = text;
    return endWith(prompt, CQuarnGet::string);
}

Refusal takeEnter(PromptState& prompt) {
    if (!prompt.objects.ids.empty())
        return endObjects(prompt);
    if (prompt.accepts_nothing) {
        prompt.text = prompt.default_answer.value_or(KM_wString());
        return endWith(prompt, CQuarnGet::nothing);
    }
    if (!prompt.default_answer)
        return KM_wString(L"Enter an answer; there is no default");
    const KM_wString default_answer = *prompt.default_answer;
    Refusal refusal = takeText(prompt, default_answer, true);
    if (!refusal)
        prompt.text = default_answer;
    if (!refusal && prompt.kind == Question::Kind::object && prompt.result == CQuarnGet::no_result)
        return endObjects(prompt);
    return refusal;
}

} // namespace

Refusal takeAnswer(PromptState& prompt, const Answer& answer, bool literal) {
    switch (answer.kind) {
    case Answer::Kind::text:
        return takeText(prompt, answer.text, literal);
    case Answer::Kind::enter:
        return takeEnter(prompt);
    case Answer::Kind::cancel:
    case Answer::Kind::nobody:
        break;
    }
    return endWith(prompt, CQuarnGet::cancel);
}

} // namespace quarn
