#pragma once

#include "ground/Result.h"

#include <deque>
#include <string>
#include <string_view>

namespace quarn {

/// A word of a command line. A quoted word, in double quotes from its first character on, is taken
/// literally: it is never Enter, Escape or the click of an option.
struct CommandWord {
    std::wstring text;
    bool quoted = false;
};

/// One command line, split up.
struct CommandLine {
    std::wstring name;             ///< the command's name without prefixes; empty in a blank line
    bool english_name = false;     ///< a "_" stood before the name: it is the English one
    bool without_dialogs = false;  ///< a "-" stood before the name
    std::deque<CommandWord> words; ///< what follows the name

    bool isBlank() const { return name.empty(); }
};

/// Splits a text at blanks; double quotes group and may stand inside a word (`a="b c"` is one
/// word).
/// @return an error when a quote is not closed
Result<std::deque<CommandWord>> splitWords(std::wstring_view text);

/// Reads a command line. Before the name may stand, in any order, "_" (English name), "-" (no
/// dialogs) and "!", which may also stand alone. "!" ends the prompts that are pending inside the
/// script; one line is one command here, so there are none and it only separates.
/// @return an error when a quote is not closed or a prefix stands without a name
Result<CommandLine> parseCommandLine(std::wstring_view line);

} // namespace quarn
