#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn run`: runs a script file, after reading a model where one is named.
Outcome runScript(const ScriptOptions& options);

} // namespace quarn::program
