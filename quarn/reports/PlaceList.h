#pragma once

#include "quarn/words/Outcome.h"

#include <string>

namespace quarn::program {

/// `quarn places`: lists the places that a sun study knows by name.
Outcome listPlaces(const std::string& text);

} // namespace quarn::program
