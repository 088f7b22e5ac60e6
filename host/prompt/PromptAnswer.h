#pragma once

#include "host/prompt/PromptState.h"

#include <optional>

namespace quarn {

/// Checks an answer to a question and, when it is good, stores how the question ended.
///
/// @param answer   text, Enter or Escape
/// @param literal  the text was quoted: it clicks no option of a text prompt
/// @return nothing when the question ended; otherwise what a good answer would be, as a request
///         ("Enter a number from 1 to 12") without a full stop
std::optional<KM_wString> takeAnswer(PromptState& prompt, const Answer& answer, bool literal);

} // namespace quarn
