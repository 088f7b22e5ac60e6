#pragma once

#include "host/front_end/FrontEnd.h"
#include "kelmar/KM_Point.h"
#include "sdk/qncore/QnGet.h"

#include <optional>
#include <string_view>
#include <vector>

namespace quarn {

/// An option of a prompt. Its index, from 1, is its place in the list.
struct PromptOption {
    CQuarnCommandOptionName name;
    std::optional<CQuarnCommandOptionValue> value; ///< what a plain option shows
    struct Toggle {
        CQuarnCommandOptionValue off;
        CQuarnCommandOptionValue on;
        bool is_on = false;
        bool* variable = nullptr; ///< the command's variable; may be null
    };
    std::optional<Toggle> toggle;

    /// The value it shows now; null for an option without one.
    const CQuarnCommandOptionValue* shownValue() const;
};

/// What a question for objects wants, and what was given.
struct ObjectPick {
    unsigned filter = CQuarnGetObject::any_object;
    bool takes_selection = false;
    bool ignores_unacceptable = false; ///< of the selection
    std::size_t minimum = 1;
    std::size_t maximum = 1;  ///< 0: none
    std::vector<KM_UUID> ids; ///< what was given

    bool isEnough() const { return ids.size() >= minimum; }
    bool isFull() const { return maximum > 0 && ids.size() >= maximum; }
};

/// What a command has set up about a question, and how the question ended.
struct PromptState {
    Question::Kind kind = Question::Kind::option;
    KM_wString prompt;
    bool accepts_nothing = false;
    std::optional<KM_wString> default_answer;
    std::vector<PromptOption> options;
    bool takes_points = false;           ///< text is a point, written x,y,z
    bool accepts_text = false;           ///< any text is as good an answer as an option
    double lower_limit = KM_UNSET_VALUE; ///< unset: none
    double upper_limit = KM_UNSET_VALUE; ///< unset: none
    ObjectPick objects;

    CQuarnGet::result result = CQuarnGet::no_result;
    CQuarnCommand::result command_result = CQuarnCommand::success;
    CQuarnCommandOption picked;
    KM_wString text;      ///< what was typed, or the default after Enter
    double number = 0;    ///< what was given, or the default
    int whole_number = 0; ///< what was given, or the default

    /// Adds an option. @return its index, or 0 when the name is empty or there already
    int addOption(PromptOption option);
    /// The question as a front end shows it.
    Question question() const;
    /// Forgets how the question ended last time; the objects that were given before an option was
    /// picked stay.
    void startAsking();
};

} // namespace quarn
