#pragma once

#include "quarn/farm/FarmRequest.h"
#include "quarn/session/HostSession.h"

namespace quarn::program {

/// `quarn farm submit`: shares out the frames that are missing, writes the job script and submits
/// it; or only shows both.
Outcome submitToFarm(const FarmRequest& request, const CommonOptions& common);

} // namespace quarn::program
