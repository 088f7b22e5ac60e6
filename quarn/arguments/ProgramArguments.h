#pragma once

#include "quarn/words/Outcome.h"

namespace quarn::program {

/// Reads the program's arguments and does what they ask for; help and mistakes end it at once.
Outcome runArguments(int argument_count, const char* const* arguments);

} // namespace quarn::program
