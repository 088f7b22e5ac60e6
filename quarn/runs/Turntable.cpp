#include "quarn/runs/Turntable.h"

#include "quarn/runs/Recording.h"
#include "quarn/scripts/TurntableRequest.h"
#include "quarn/scripts/TurntableScript.h"

namespace quarn::program {

Outcome recordTurntable(const TurntableOptions& options) {
    const auto checked = checkTurntable(options);
    if (const Outcome* const refusal = std::get_if<Outcome>(&checked))
        return *refusal;
    const TurntableRequest& request = std::get<TurntableRequest>(checked);
    return recordOrShow(request.recording, turntableLines(request), options.recording);
}

} // namespace quarn::program
