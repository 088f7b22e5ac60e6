#pragma once

#include "quarn/session/HostSession.h"

namespace quarn::program {

/// `quarn info`: reads a model file and tells what is in it.
Outcome reportModel(const std::filesystem::path& model, const CommonOptions& common);

} // namespace quarn::program
