#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn curves`: reads a model file and lists what a camera can follow in it.
Outcome reportCurves(const CurvesOptions& options);

} // namespace quarn::program
