#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// `quarn places`: lists the places that a sun study knows by name.
Outcome listPlaces(const PlacesOptions& options);

} // namespace quarn::program
