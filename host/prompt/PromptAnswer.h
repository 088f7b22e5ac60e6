#pragma once

#include "host/prompt/PromptState.h"

#include <optional>

namespace quarn {

/// Checks an answer to a question and, when it is good, stores how the question ended. Only a
/// question for several objects may go on after a good answer; its result is no_result then.
///
/// @param answer   text, Enter or Escape
/// @param literal  the text was quoted: it picks no option of a question for text or objects
/// @return nothing when the answer was good; otherwise what a good answer would be, as a request
///         ("Enter a number from 1 to 12") without a full stop
std::optional<KM_wString> takeAnswer(PromptState& prompt, const Answer& answer, bool literal);

} // namespace quarn
