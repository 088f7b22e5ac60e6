#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/session/HostSession.h"

#include <filesystem>
#include <functional>
#include <string>
#include <vector>

namespace quarn::program {

/// Reads a saved document and has host commands done with its animation; or only shows all lines.
/// @param done  runs the lines in the session and tells how they ended
Outcome runOnDocument(const std::filesystem::path& document, const std::vector<std::string>& lines,
                      const ScriptUse& use, const std::function<Outcome(HostSession&)>& done);

} // namespace quarn::program
