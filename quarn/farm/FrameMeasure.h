#pragma once

#include "host/session/RecordingProgress.h"
#include "quarn/farm/FarmRequest.h"
#include "quarn/words/Outcome.h"

#include <optional>
#include <variant>

namespace quarn::program {

/// What drawing one frame told.
struct MeasuredFrame {
    FrameCost cost;
    RecordingProgress recording; ///< with the marks of the document and its settings
};

/// Draws a frame into a folder of its own, which goes away again, with as many threads as a task
/// has.
/// @return how the program ends where the frame cannot be drawn
std::variant<MeasuredFrame, Outcome> measureFrame(const FarmRequest& request, int frame);

/// Begins the recording anew in its folder with its first frame, so that tasks that begin together
/// only have to go on with it.
/// @return how the program ends where that cannot be done; nothing where it is
std::optional<Outcome> beginAnew(const FarmRequest& request);

/// This program's own file.
std::filesystem::path programFile();

} // namespace quarn::program
