#pragma once

#include "quarn/CommandLine.h"
#include "quarn/Outcome.h"

namespace quarn::program {

/// `quarn run`: runs a script file, after reading a model where one is named.
Outcome runScript(const ScriptOptions& options);

} // namespace quarn::program
