#pragma once

#include "host/prompt/PromptState.h"

namespace quarn {

/// Asks a question: of the words that the running command's line has left, and when there are none,
/// of the person. What a person answers wrongly is told and asked again; a wrong word of a script
/// is told with its place and cancels the question, so that the next word never answers another
/// question than it was written for. Where nobody can be asked, the missing answer is told and the
/// question cancelled. Outside a command the question fails, and that is told.
///
/// @param call  the interface's name of the call
/// @return how the question ended; `prompt` holds the answer
CQuarnGet::result askQuestion(PromptState& prompt, const char* call);

} // namespace quarn
