#include "host/prompt/OptionPick.h"

namespace quarn {

namespace {

std::wstring_view withoutUnderscore(std::wstring_view word) {
    return word.starts_with(L'_') ? word.substr(1) : word;
}

bool means(std::wstring_view word, const KM_wString& english, const KM_wString& local) {
    for (const std::wstring_view text : {word, withoutUnderscore(word)}) {
        const KM_wString wanted(text);
        if (english.CompareNoCase(wanted) == 0 || local.CompareNoCase(wanted) == 0)
            return true;
    }
    return false;
}

bool means(std::wstring_view word, const CQuarnCommandOptionValue& value) {
    return means(word, value.m_english, value.m_local);
}

/// The index of the option with this name, or 0.
int findOption(const PromptState& prompt, std::wstring_view name) {
    for (std::size_t i = 0; i < prompt.options.size(); ++i) {
        const CQuarnCommandOptionName& candidate = prompt.options[i].name;
        if (means(name, candidate.m_english, candidate.m_local))
            return static_cast<int>(i) + 1;
    }
    return 0;
}

OptionPick readToggleValue(const PromptOption::Toggle& toggle, int index, std::wstring_view value) {
    if (means(value, toggle.on))
        return {OptionPick::Kind::picked, index, true};
    if (means(value, toggle.off))
        return {OptionPick::Kind::picked, index, false};
    return {OptionPick::Kind::bad_value, index, false};
}

} // namespace

OptionPick readOption(const PromptState& prompt, std::wstring_view word) {
    if (const int index = findOption(prompt, word)) {
        const auto& toggle = prompt.options[static_cast<std::size_t>(index) - 1].toggle;
        return {OptionPick::Kind::picked, index, toggle && !toggle->is_on};
    }
    const std::size_t equals = word.find(L'=');
    if (equals == word.npos)
        return {};
    const int index = findOption(prompt, word.substr(0, equals));
    if (index == 0)
        return {};
    const auto& toggle = prompt.options[static_cast<std::size_t>(index) - 1].toggle;
    return toggle ? readToggleValue(*toggle, index, word.substr(equals + 1)) : OptionPick{};
}

OptionPick readOptionClick(const PromptState& prompt, std::wstring_view word) {
    if (word.size() < 2 || !word.starts_with(L'[') || !word.ends_with(L']'))
        return {};
    return readOption(prompt, word.substr(1, word.size() - 2));
}

} // namespace quarn
