#include "host/session/SunHours.h"

#include "host/app/Application.h"
#include "host/sunhours/SunHoursMaking.h"

namespace quarn {

std::vector<std::filesystem::path> sunHoursFiles(const SunHoursRequest& request) {
    return filesOf(request);
}

Result<SunHoursFiles> makeSunHours(CQuarnDoc& document, const SunHoursRequest& request,
                                   const std::function<bool(double share)>& watch) {
    const std::filesystem::path shared =
        Application::current()->options().viewer_folder.parent_path();
    auto made = writeSunHours(Document::of(document), request,
                              shared / "sunhours" / "sunhours.html", watch);
    if (!made)
        return made.error();
    SunHoursReport& report = made.value();
    return SunHoursFiles{std::move(report.files), report.most_hours, report.steps,
                         report.is_given_up};
}

} // namespace quarn
