#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn flythrough`: composes a script of host commands, and runs it or returns it.
Outcome recordFlythrough(const FlythroughOptions& options);

/// `quarn path`: as above.
Outcome recordPath(const PathOptions& options);

} // namespace quarn::program
