#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/scripts/ViewerScript.h"

namespace quarn::program {

/// `quarn page`: composes a script that writes the viewer page of recorded frames, and runs it or
/// returns it.
/// @param recorded  their folder, or the file NAME.frames.json in it
Outcome writePage(const std::filesystem::path& recorded, const ViewerRequest& request,
                  const ScriptUse& use);

} // namespace quarn::program
