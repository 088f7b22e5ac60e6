#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn turntable`: composes a script of host commands, and runs it or returns it.
Outcome recordTurntable(const TurntableOptions& options);

} // namespace quarn::program
