#pragma once

#include "quarn/runs/Recording.h"
#include "quarn/session/HostSession.h"

#include <filesystem>
#include <functional>
#include <string>

namespace quarn::program {

/// Reads a saved document and has one host command done with its animation; or only shows both
/// lines.
/// @param done  runs the line in the session and tells how it ended
Outcome runOnDocument(const std::filesystem::path& document, const std::string& line,
                      const ScriptUse& use, const std::function<Outcome(HostSession&)>& done);

} // namespace quarn::program
