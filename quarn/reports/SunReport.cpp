#include "quarn/reports/SunReport.h"

#include "quarn/reports/SunTelling.h"

namespace quarn::program {

namespace {

using std::chrono::days;
using std::chrono::local_days;

SunDay dayOf(const CivilSite& site, local_days date) {
    // Where midnight is skipped, the day begins at the moment of the change.
    return {date, sunEvents({site.latitude_deg, site.longitude_deg}, site.zone.read(date).first,
                            site.zone.read(date + days(1)).first)};
}

SunTelling tell(const SunRequest& request) {
    const CivilSite& site = request.site;
    SunTelling telling;
    for (auto time = request.from; time <= request.to; time += request.step) {
        telling.positions.push_back(
            {time, sunPosition({site.latitude_deg, site.longitude_deg}, time)});
        const auto date = std::chrono::floor<days>(site.zone.at(time).local);
        if (telling.days.empty() || telling.days.back().date != date)
            telling.days.push_back(dayOf(site, date));
    }
    return telling;
}

} // namespace

Outcome reportSun(const SunRequest& request) {
    const SunTelling telling = tell(request);
    if (request.form == SunRequest::Form::csv)
        return Outcome::success(csvOf(request, telling));
    if (request.form == SunRequest::Form::json)
        return Outcome::success(jsonOf(request, telling));
    return Outcome::success(textOf(request, telling));
}

} // namespace quarn::program
