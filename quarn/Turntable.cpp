#include "quarn/Turntable.h"

#include "quarn/Recording.h"
#include "quarn/TurntableRequest.h"
#include "quarn/TurntableScript.h"

namespace quarn::program {

Outcome recordTurntable(const TurntableOptions& options) {
    const auto checked = checkTurntable(options);
    if (const Outcome* const refusal = std::get_if<Outcome>(&checked))
        return *refusal;
    const TurntableRequest& request = std::get<TurntableRequest>(checked);
    return recordOrShow(request.recording, turntableLines(request), options.recording);
}

} // namespace quarn::program
