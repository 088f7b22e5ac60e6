#pragma once

#include "quarn/session/HostSession.h"

namespace quarn::program {

/// `quarn console`: runs the commands that a person types, until they end it.
Outcome runConsole(const std::filesystem::path& model, const CommonOptions& common);

} // namespace quarn::program
