#pragma once

#include "quarn/session/HostSession.h"

namespace quarn::program {

/// `quarn run`: runs a script file, after reading a model where one is named.
Outcome runScript(const std::filesystem::path& script, const std::filesystem::path& model,
                  const CommonOptions& common);

} // namespace quarn::program
