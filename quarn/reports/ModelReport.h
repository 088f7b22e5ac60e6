#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn info`: reads a model file and tells what is in it.
Outcome reportModel(const ModelOptions& options);

} // namespace quarn::program
