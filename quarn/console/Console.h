#pragma once

#include "host/session/Recovery.h"
#include "quarn/session/HostSession.h"

#include <optional>

namespace quarn::program {

/// `quarn console`: runs the commands that a person types, until they end it.
/// @param recovery  how unsaved work is kept; nothing: not at all
Outcome runConsole(const std::filesystem::path& model, const CommonOptions& common,
                   const std::optional<RecoveryOptions>& recovery);

} // namespace quarn::program
