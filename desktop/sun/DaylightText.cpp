#include "desktop/sun/DaylightText.h"

#include "desktop/texts/Texts.h"
#include "host/clock/WallText.h"
#include "host/sun/SunEvents.h"

namespace quarn::desktop {

namespace {

using namespace std::chrono;

QString shown(const Zone& clock, const std::optional<sys_seconds>& moment) {
    return moment ? QString::fromStdString(timeText(clock.at(*moment))) : QString("–");
}

} // namespace

DaylightTimes daylightTimes(const StudiedSite& site, const Zone& clock, year_month_day day) {
    const local_days midnight(day);
    const SunEvents events =
        sunEvents({site.latitude_deg, site.longitude_deg}, clock.read(midnight).first,
                  clock.read(midnight + days(1)).first);
    return {events.first(SunEvent::Kind::rise), events.first(SunEvent::Kind::transit),
            events.first(SunEvent::Kind::set), events.day_length};
}

QString daylightText(const DaylightTimes& times, const Zone& clock) {
    if (!times.rise && !times.set)
        return times.length > 0s ? localized(L"The sun does not set that day.", 45538)
                                 : localized(L"The sun does not rise that day.", 45539);
    const sys_seconds moment = times.set.value_or(times.rise.value_or(sys_seconds{}));
    return localized(L"Sunrise %1, sunset %2 %3", 45540)
        .arg(shown(clock, times.rise), shown(clock, times.set),
             QString::fromStdString(clock.at(moment).abbreviation));
}

} // namespace quarn::desktop
