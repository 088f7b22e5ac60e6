#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn frame`: composes a script that writes one frame of a document's animation, and runs it
/// or returns it.
Outcome writeSingleFrame(const FrameOptions& options);

} // namespace quarn::program
