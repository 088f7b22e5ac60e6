#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnObject.h"

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
        object = 6,    ///< objects were given
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
    /// @param variable  set to `current` now, changed by each pick; may be null. Must outlive the
    ///                  question, or its next ClearCommandOptions.
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

/// Asks for one of several options; any other word is handed on as text (`string`), and told to be
/// no option unless AcceptString was called. A default that names an option picks it when Enter
/// takes the default.
class QNCORE_API CQuarnGetOption : public CQuarnGet {
public:
    CQuarnGetOption();
    ~CQuarnGetOption() override;
    /// Whether the question takes text beside its options. Off in a new question.
    void AcceptString(bool accept = true);
    result GetOption();
    /// The text that was typed; the default text after Enter.
    const wchar_t* String() const;
};

/// Asks for text. A word is always text; options are clicked, and written `[Name]` in a script.
/// Where there are options, a word with "_" before it that names none of them is told to be none
/// if the command fails at it; in quotes it is not.
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

/// Asks for objects of the active document.
///
/// An object is named by its name, ignoring case, or by its id, with or without braces; where one
/// object's name is another one's id, the name wins. In a command line a name with blanks stands in
/// double quotes. A word that names an option picks it, with or without "_"; a quoted word is
/// always an object, so `"All"` is the object of that name where `All` is an option. A name with a
/// double quote in it cannot be written in a command line; the id can. Hidden objects can be given.
///
/// A word that means no object, or one that the filter does not admit, is told by name and is a bad
/// answer as at every question: a person is asked again, a script is cancelled.
class QNCORE_API CQuarnGetObject : public CQuarnGet {
public:
    /// The kinds of objects that a filter admits; they are combined by "or".
    enum geometry : unsigned {
        point_object = 1,
        curve_object = 4,
        mesh_object = 32,
        any_object = point_object | curve_object | mesh_object,
    };

    CQuarnGetObject();
    ~CQuarnGetObject() override;

    /// Whether the objects that are selected in the document are taken without asking, where they
    /// are as many as are wanted. Off in a new question.
    ///
    /// @param enable               true takes the selection
    /// @param ignore_unacceptable  true leaves selected objects out that the filter does not admit;
    ///                             false asks when there is one
    void EnablePreSelect(bool enable, bool ignore_unacceptable);
    /// The kinds of objects that are admitted, `any_object` in a new question. Bits that are no
    /// kind are left out of account; a filter of no kind admits nothing.
    void SetGeometryFilter(unsigned filter);

    /// Asks until enough objects are there. An object that is given twice counts once.
    ///
    /// @param minimum  Enter ends the question once so many were given; below 1 counts as 1. Enter
    ///                 with none given is `nothing`, with AcceptNothing(true)
    /// @param maximum  the question ends by itself when so many were given, so 1 and 1 is one pick;
    ///                 0 or less: only Enter ends it. Less than the minimum counts as the minimum
    /// @return `object` when objects were given. Picking an option ends the question; when asked
    ///         again it goes on with the objects that were given before. After `cancel` and
    ///         `nothing` there are none
    result GetObjects(int minimum = 1, int maximum = 1);

    /// How many objects were given.
    int ObjectCount() const;
    /// An object that was given, in the order in which they were; those of the selection come in
    /// the document's order.
    /// @param index  from 0; a reference to nothing for one outside 0 to ObjectCount() - 1
    CQuarnObjRef Object(int index) const;
};
