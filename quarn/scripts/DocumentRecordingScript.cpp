#include "quarn/scripts/DocumentRecordingScript.h"

namespace quarn::program {

RecordingScript composeDocumentRecording(const DocumentRecordingRequest& request,
                                         const std::filesystem::path& recorded) {
    RecordingScript script;
    script.reading = readingLine(request.document);
    if (request.quality)
        script.set_up.push_back("_-JpegQuality " + std::to_string(*request.quality));
    script.beginning = beginningLine(request.start, request.part.text());
    script.recording = recordingLine(request.folder);
    // Not while it records: frames that are kept, and those of others, are in the film too.
    if (!request.film.file.empty())
        script.sharing.push_back(folderFilmLine(request.film, recorded));
    if (request.viewer.is_wanted)
        script.sharing.push_back(viewerLine(recorded, request.viewer));
    return script;
}

} // namespace quarn::program
