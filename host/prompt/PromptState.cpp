#include "host/prompt/PromptState.h"

#include "host/prompt/ObjectAnswer.h"

#include <algorithm>

namespace quarn {

const CQuarnCommandOptionValue* PromptOption::shownValue() const {
    if (toggle)
        return toggle->is_on ? &toggle->on : &toggle->off;
    return value ? &*value : nullptr;
}

int PromptState::addOption(PromptOption option) {
    if (option.name.m_local.IsEmpty())
        option.name.m_local = option.name.m_english;
    const auto has_same_name = [&](const PromptOption& other) {
        return other.name.m_english.CompareNoCase(option.name.m_english) == 0 ||
               other.name.m_local.CompareNoCase(option.name.m_local) == 0;
    };
    if (option.name.m_english.IsEmpty() || std::ranges::any_of(options, has_same_name))
        return 0;
    options.push_back(std::move(option));
    return static_cast<int>(options.size());
}

Question PromptState::question() const {
    Question question{kind, prompt, {}, default_answer, accepts_nothing, {}, takes_points};
    for (const PromptOption& option : options) {
        const CQuarnCommandOptionValue* value = option.shownValue();
        question.options.push_back(
            {option.name.m_english, option.name.m_local, value ? value->m_local : KM_wString()});
    }
    if (kind == Question::Kind::object) {
        question.object_names = objectNames(objects);
        question.accepts_nothing = objects.ids.empty() ? accepts_nothing : objects.isEnough();
    }
    return question;
}

void PromptState::startAsking() {
    if (result != CQuarnGet::option)
        objects.ids.clear();
    result = CQuarnGet::no_result;
    command_result = CQuarnCommand::failure;
    picked = {};
    text.Empty();
}

} // namespace quarn
