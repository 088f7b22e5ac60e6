#include "quarn/runs/CameraPath.h"

#include "quarn/runs/Recording.h"
#include "quarn/scripts/CameraPathRequest.h"
#include "quarn/scripts/CameraPathScript.h"

namespace quarn::program {

namespace {

Outcome recordChecked(const std::variant<CameraPathRequest, Outcome>& checked,
                      const RecordingOptions& options) {
    if (const Outcome* const refusal = std::get_if<Outcome>(&checked))
        return *refusal;
    const CameraPathRequest& request = std::get<CameraPathRequest>(checked);
    return recordOrShow(request.recording, cameraPathLines(request), options);
}

} // namespace

Outcome recordFlythrough(const FlythroughOptions& options) {
    return recordChecked(checkFlythrough(options), options.recording);
}

Outcome recordPath(const PathOptions& options) {
    return recordChecked(checkPath(options), options.recording);
}

} // namespace quarn::program
