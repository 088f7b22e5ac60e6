#include "quarn/runs/SunStudy.h"

#include "quarn/runs/Recording.h"
#include "quarn/scripts/SunStudyRequest.h"
#include "quarn/scripts/SunStudyScript.h"

namespace quarn::program {

namespace {

Outcome recordChecked(const std::variant<SunStudyRequest, Outcome>& checked,
                      const RecordingOptions& options) {
    if (const Outcome* const refusal = std::get_if<Outcome>(&checked))
        return *refusal;
    const SunStudyRequest& request = std::get<SunStudyRequest>(checked);
    return recordOrShow(request.recording, sunStudyLines(request), options);
}

} // namespace

Outcome recordDay(const DayOptions& options) {
    return recordChecked(checkDay(options), options.recording);
}

Outcome recordSeason(const SeasonOptions& options) {
    return recordChecked(checkSeason(options), options.recording);
}

} // namespace quarn::program
