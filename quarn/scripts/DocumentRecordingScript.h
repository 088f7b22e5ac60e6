#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/words/FrameRanges.h"

#include <optional>

namespace quarn::program {

/// A recording of the animation that a document has.
struct DocumentRecordingRequest {
    std::filesystem::path document;
    std::filesystem::path folder;
    FrameRanges part; ///< that is to be made of it
    RecordingStartKind start = RecordingStartKind::resume;
    std::optional<int> quality; ///< of jpg; 1 to 100; nothing: the host's
    FilmRequest film;           ///< of all frames
    ViewerRequest viewer;
};

/// @param recorded  what the film and the viewer page are made from: the folder, or where it may
///                  hold several recordings its NAME.frames.json
RecordingScript composeDocumentRecording(const DocumentRecordingRequest& request,
                                         const std::filesystem::path& recorded);

} // namespace quarn::program
