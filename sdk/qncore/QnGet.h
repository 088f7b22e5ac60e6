#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnLocalize.h"

#include <memory>

namespace quarn {
struct PromptState;
}

/// The option that was picked at a prompt.
class QNCORE_API CQuarnCommandOption {
public:
    /// The index that AddCommandOption returned for it, from 1.
    int m_option_index = 0;
};

/// A question at the command line. A command sets it up, asks it, and reads how it ended. Asking is
/// only possible while a command runs.
class QNCORE_API CQuarnGet {
public:
    /// How the question ended.
    enum result : int {
        no_result = 0, ///< not asked yet
        cancel = 1,    ///< Escape, or a script that could not answer
        nothing = 2,   ///< Enter, with AcceptNothing(true)
        option = 3,    ///< an option was picked
        number = 4,    ///< a number was given, or Enter took the default
        string = 5,    ///< text was given, or Enter took the default
    };

    CQuarnGet();
    virtual ~CQuarnGet();
    CQuarnGet(const CQuarnGet&) = delete;
    CQuarnGet& operator=(const CQuarnGet&) = delete;

    /// The question, without a colon.
    void SetCommandPrompt(const wchar_t* prompt);
    /// Whether Enter ends the question with `nothing`. Without it Enter gives the default answer,
    /// where there is one, and is asked again where there is none.
    void AcceptNothing(bool accept = true);
    /// The text that Enter stands for, shown with the question.
    void SetDefaultString(const wchar_t* text);

    /// Adds an option. @return its index, from 1, or 0 when the name is empty or there already.
    int AddCommandOption(const CQuarnCommandOptionName& name);
    /// Adds an option that shows a value, as in `Name=Value`. Result as above.
    int AddCommandOption(const CQuarnCommandOptionName& name,
                         const CQuarnCommandOptionValue& value);
    /// Adds an option with two values. Picking it changes the variable and ends the question with
    /// `option`.
    ///
    /// @param current   the value shown first
    /// @param variable  set to `current` now, changed by each pick; must outlive the question or
    /// its
    ///                  next ClearCommandOptions. May be null.
    /// @return its index, from 1, or 0 when the name is empty or there already
    int AddCommandOptionToggle(const CQuarnCommandOptionName& name,
                               const CQuarnCommandOptionValue& off_value,
                               const CQuarnCommandOptionValue& on_value, bool current,
                               bool* variable);
    /// Removes all options; indices start from 1 again.
    void ClearCommandOptions();

    /// How the question ended.
    result Result() const;
    /// success, also after Enter and after an option; cancel after Escape; failure when the
    /// question could not be asked.
    CQuarnCommand::result CommandResult() const;
    /// The option that was picked; null when none was. Valid until the question is asked again.
    const CQuarnCommandOption* Option() const;

protected:
    std::unique_ptr<quarn::PromptState> m_state;
};

/// Asks for one of several options; any other word is handed on as text (`string`). A default that
/// names an option picks it when Enter takes the default.
class QNCORE_API CQuarnGetOption : public CQuarnGet {
public:
    CQuarnGetOption();
    ~CQuarnGetOption() override;
    result GetOption();
    /// The text that was typed; the default text after Enter.
    const wchar_t* String() const;
};

/// Asks for text. A word is always text; options are clicked, and written `[Name]` in a script.
class QNCORE_API CQuarnGetString : public CQuarnGet {
public:
    CQuarnGetString();
    ~CQuarnGetString() override;
    result GetString();
    /// The text that was given; the default text after Enter.
    const wchar_t* String() const;
};

/// Asks for a number.
class QNCORE_API CQuarnGetNumber : public CQuarnGet {
public:
    CQuarnGetNumber();
    ~CQuarnGetNumber() override;
    void SetDefaultNumber(double value);
    /// Refuses numbers below (above) the limit; the limit itself is allowed. A default outside is
    /// refused too. KM_UNSET_VALUE is no limit.
    /// @param strict  true refuses a number outside; every question here refuses, whatever it says
    void SetLowerLimit(double limit, bool strict = false);
    void SetUpperLimit(double limit, bool strict = false);
    result GetNumber();
    /// The number that was given; the default after Enter.
    double Number() const;
};

/// Asks for a whole number.
class QNCORE_API CQuarnGetInteger : public CQuarnGet {
public:
    CQuarnGetInteger();
    ~CQuarnGetInteger() override;
    void SetDefaultInteger(int value);
    /// As CQuarnGetNumber's.
    void SetLowerLimit(double limit, bool strict = false);
    void SetUpperLimit(double limit, bool strict = false);
    result GetNumber();
    /// The number that was given; the default after Enter.
    int Number() const;
};
