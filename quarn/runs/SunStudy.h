#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn day`: composes a script of host commands, and runs it or returns it.
Outcome recordDay(const DayOptions& options);

/// `quarn season`: as above.
Outcome recordSeason(const SeasonOptions& options);

} // namespace quarn::program
