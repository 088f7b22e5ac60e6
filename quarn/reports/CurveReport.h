#pragma once

#include "quarn/session/HostSession.h"

namespace quarn::program {

/// `quarn curves`: reads a model file and lists what a camera can follow in it.
Outcome reportCurves(const std::filesystem::path& model, const CommonOptions& common);

} // namespace quarn::program
