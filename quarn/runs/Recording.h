#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// Composes the script of a recording, and runs it or, where it is only to be shown, returns it.
///
/// @param lines    the commands of this kind of animation
/// @param options  those that the request was made from
Outcome recordOrShow(const RecordingRequest& request, const AnimationLines& lines,
                     const RecordingOptions& options);

} // namespace quarn::program
