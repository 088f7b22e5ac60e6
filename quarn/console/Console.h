#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn console`: runs the commands that a person types, until they end it.
Outcome runConsole(const ConsoleOptions& options);

} // namespace quarn::program
