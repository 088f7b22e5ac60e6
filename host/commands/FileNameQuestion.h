#pragma once

#include "host/prompt/PromptState.h"

namespace quarn {

/// A question whose text is a file, which may begin with "_" as the English name of an option does.
class FileNameQuestion : public CQuarnGetString {
public:
    FileNameQuestion() { m_state->accepts_text = true; }
};

} // namespace quarn
