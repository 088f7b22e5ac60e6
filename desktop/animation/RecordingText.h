#pragma once

#include "host/front_end/RecordingReport.h"

#include <QString>

namespace quarn::desktop {

/// What became of a recording: how many pictures were written and are there, what its page shows
/// where that is less than it lists, and what earlier ones left over. In the user's language.
QString recordingText(const RecordingReport& report);

} // namespace quarn::desktop
