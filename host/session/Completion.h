#pragma once

#include "host/front_end/FrontEnd.h"
#include "host/session/Session.h"

#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// What the text before the cursor may be completed to, wherever command lines are typed.
struct Completion {
    struct Candidate {
        std::wstring text;   ///< replaces what was typed
        std::wstring shown;  ///< as a list shows it
        std::wstring ending; ///< follows when there is no other candidate
    };
    std::size_t begin = 0; ///< where the text begins that a candidate replaces
    std::vector<Candidate> candidates;

    /// The text that all candidates begin with, ignoring case, as the first one spells it.
    QNCORE_API std::wstring commonText() const;
};

/// Completes a line that begins with a command's name: the name, whatever prefixes it has, and
/// behind it the names of files.
/// @param typed  the line up to the cursor
QNCORE_API Completion completeCommand(std::wstring_view typed,
                                      const std::vector<CommandName>& names);

/// Completes the answer to a question: its options as they are typed there, the names of objects
/// where the question is for some, and the names of files where any text is an answer.
/// @param typed  the answer up to the cursor; all of it is one answer, blanks included
QNCORE_API Completion completeAnswer(std::wstring_view typed, const Question& question);

/// An option as it is picked at a question: its local name, in brackets where a word alone would
/// be text.
/// @param inside  the name, or `Name=Value`
QNCORE_API std::wstring optionText(Question::Kind kind, std::wstring_view inside);

} // namespace quarn
