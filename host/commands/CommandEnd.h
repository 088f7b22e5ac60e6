#pragma once

#include "sdk/qncore/QnCommand.h"

#include <string_view>

namespace quarn {

/// Tells why a command could not do its work.
/// @param message  UTF-8, a sentence without a line break at its end
/// @return failure
CQuarnCommand::result fail(std::string_view message);

/// Tells that a word is none of a prompt's options.
/// @param expected  the options, as the end of the sentence "Give ..."
/// @return failure
CQuarnCommand::result failForWord(const wchar_t* word, const char* expected);

} // namespace quarn
