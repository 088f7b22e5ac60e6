#pragma once

#include "quarn/arguments/OptionAdder.h"
#include "quarn/scripts/StudyView.h"

#include <optional>
#include <string>

namespace quarn::program {

/// Adds --view, --azimuth, --elevation, --target, --distance and --lens.
/// @param views  that --view takes, a part of a sentence
void addStudyView(const OptionAdder& add, StudyView& view, const std::string& views);

/// What of a view does not go together, or nothing.
/// @param is_parallel  whether the named view is one that knows no lens
std::optional<std::string> whyViewIsRefused(const StudyView& view, bool is_parallel);

} // namespace quarn::program
