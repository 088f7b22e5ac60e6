#pragma once

#include "quarn/CommandLine.h"
#include "quarn/Outcome.h"

namespace quarn::program {

/// `quarn info`: reads a model file and tells what is in it.
Outcome reportModel(const ModelOptions& options);

} // namespace quarn::program
