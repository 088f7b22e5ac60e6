#include "host/sunhours/SunMoments.h"

#include "host/sun/SunDirection.h"

#include <algorithm>

namespace quarn {

namespace {

using std::chrono::minutes;
using std::chrono::sys_seconds;

constexpr double SECONDS_OF_HOUR = 3600.0;

struct Span {
    sys_seconds from;
    sys_seconds to;
};

/// An end of a day's span. Where the sun does not rise or set it is midnight, and an hour that
/// clocks skip is the moment of the change: of many days these are a few.
sys_seconds endOf(const CivilSite& site, std::chrono::local_days day,
                  const std::optional<WantedTime>& wanted, bool is_end) {
    const minutes midnight = is_end ? std::chrono::hours(24) : minutes(0);
    const bool is_by_sun = wanted && wanted->since != WantedTime::Since::midnight;
    if (is_by_sun) {
        const auto found = findTime(site, std::chrono::year_month_day(day), *wanted, "", is_end);
        if (found.mistake.empty())
            return found.time;
    }
    const auto reading = site.zone.read(day + (wanted && !is_by_sun ? wanted->later : midnight));
    return is_end ? reading.second : reading.first;
}

/// Two ends that clocks show twice are as far apart as they can be.
Span spanOf(const SunHoursRequest& request, std::chrono::local_days day) {
    return {endOf(request.site, day, request.from, false),
            endOf(request.site, day, request.to, true)};
}

double hoursBetween(sys_seconds from, sys_seconds to) {
    return static_cast<double>((to - from).count()) / SECONDS_OF_HOUR;
}

void addDay(const SunHoursRequest& request, const Span& span, std::vector<SunMoment>& moments) {
    if (span.to <= span.from)
        return;
    std::vector<sys_seconds> times;
    for (sys_seconds t = span.from; t < span.to; t += minutes(request.every_minutes))
        times.push_back(t);
    times.push_back(span.to);
    const SunSite site{request.site.latitude_deg, request.site.longitude_deg};
    for (std::size_t i = 0; i < times.size(); ++i) {
        SunPosition sun = sunPosition(site, times[i]);
        if (sun.altitude_deg <= 0.0)
            continue;
        sun.azimuth_deg += request.site.north_deg;
        const sys_seconds before = times[i == 0 ? 0 : i - 1];
        const sys_seconds behind = times[std::min(i + 1, times.size() - 1)];
        moments.push_back({times[i], {directionToSun(sun), 0.5 * hoursBetween(before, behind)}});
    }
}

} // namespace

SunMoments momentsOf(const SunHoursRequest& request) {
    SunMoments all;
    const std::chrono::local_days last(request.last_day);
    for (std::chrono::local_days day(request.first_day); day <= last;
         day += std::chrono::days(request.every_days), ++all.days)
        addDay(request, spanOf(request, day), all.moments);
    for (SunMoment& moment : all.moments) {
        moment.step.hours /= all.days;
        all.hours += moment.step.hours;
    }
    return all;
}

} // namespace quarn
