#pragma once

#include "host/prompt/PromptState.h"

#include <string_view>

namespace quarn {

/// What a word says about the options of a prompt.
struct OptionPick {
    enum class Kind {
        none,      ///< it names no option
        picked,    ///< it names the option with this index
        bad_value, ///< it names a toggle, but with a value that the toggle has not
    };
    Kind kind = Kind::none;
    int index = 0;
    bool turns_on = false; ///< the new state of a toggle
};

/// Reads a word as an option: its English or local name, ignoring case, with or without a leading
/// "_", and `Name=Value` for toggles. A toggle's name alone changes it to its other value.
OptionPick readOption(const PromptState& prompt, std::wstring_view word);

/// Reads a word in brackets, `[Name]`, as the click of an option; everything else names none.
OptionPick readOptionClick(const PromptState& prompt, std::wstring_view word);

} // namespace quarn
