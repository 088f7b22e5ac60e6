#include "host/almanac/DayTimes.h"

#include "host/almanac/WantedDay.h"
#include "host/clock/WallText.h"
#include "host/sun/SunEvents.h"

#include <algorithm>

namespace quarn {

namespace {

using namespace std::chrono;

/// To the nearest minute, so that a zone told to the nearest minute shows what was asked for.
sys_seconds wholeMinute(sys_seconds moment) {
    return ceil<minutes>(moment - 30s);
}

/// The moments of a date by the clocks of a place; none where they skip the whole of it.
struct DaySpan {
    sys_seconds begin;
    sys_seconds end;
    bool is_there = true;
};

DaySpan spanOf(const Zone& zone, year_month_day day) {
    const local_days midnight(day);
    DaySpan span{zone.read(midnight).first, zone.read(midnight + days(1)).first};
    span.is_there = dateAt(zone, span.begin) == day;
    return span;
}

SunEvents eventsOf(const CivilSite& site, const DaySpan& span, double horizon_deg) {
    return sunEvents({site.latitude_deg, site.longitude_deg}, span.begin, span.end, horizon_deg);
}

/// "02:00 CET, when they are put forward to 03:00 CEST"
std::string skippedText(const Zone& zone, sys_seconds change) {
    WallTime before = zone.at(change - 1s);
    before.local += 1s;
    return timeWithZone(before) + ", when they are put forward to " +
           (dateText(before) == dateText(zone.at(change)) ? timeWithZone(zone.at(change))
                                                          : dateAndTime(zone.at(change)));
}

std::string noDay(const CivilSite& site, year_month_day day) {
    return "the date " + dateText(day) + " does not exist in " + site.zone.name() +
           ": clocks were put over it.";
}

FoundMoment byTheClock(const CivilSite& site, year_month_day day, minutes time,
                       const std::string& option, bool is_end) {
    const local_seconds local = local_days(day) + time;
    const WallReading reading = site.zone.read(local);
    using Reading = WallReading::Kind;
    const std::string shown = timeText(WallTime{local, {}, {}, false}) + " on " + dateText(day);
    if (reading.kind == Reading::skipped)
        return {FoundMoment::Kind::skipped,
                {},
                option + " " + shown + " does not exist in " + site.zone.name() +
                    ": clocks go until " + skippedText(site.zone, reading.first) + ".",
                {}};
    FoundMoment found{
        FoundMoment::Kind::found, wholeMinute(is_end ? reading.second : reading.first), {}, {}};
    if (reading.kind != Reading::twice)
        return found;
    found.kind = is_end ? FoundMoment::Kind::second_of_two : FoundMoment::Kind::first_of_two;
    found.note = shown + " comes twice: " + option + " takes the " + (is_end ? "second" : "first") +
                 ", " + timeWithZone(site.zone.at(found.time));
    return found;
}

FoundMoment byTheSun(const CivilSite& site, year_month_day day, const WantedTime& wanted,
                     const std::string& option) {
    const bool is_rise = wanted.since == WantedTime::Since::sunrise;
    const SunEvents events = eventsOf(site, spanOf(site.zone, day), PUBLISHED_HORIZON_DEG);
    const auto event = events.first(is_rise ? SunEvent::Kind::rise : SunEvent::Kind::set);
    if (!event)
        return {is_rise ? FoundMoment::Kind::no_rise : FoundMoment::Kind::no_set,
                {},
                option + ": the sun does not " + (is_rise ? "rise" : "set") + " there on " +
                    dateText(day) + "; give a time such as 09:00.",
                {}};
    return {FoundMoment::Kind::found, wholeMinute(*event + wanted.later), {}, {}};
}

/// Whether the sun is up at a moment of the day that the events are of.
bool isUp(const SunEvents& events, sys_seconds moment) {
    bool is_up = events.course == SunEvents::Course::polar_day;
    bool is_first = true;
    for (const SunEvent& event : events.events) {
        if (event.kind == SunEvent::Kind::transit)
            continue;
        const bool rises = event.kind == SunEvent::Kind::rise;
        if (event.time > moment)
            return is_first ? !rises : is_up;
        is_up = rises;
        is_first = false;
    }
    return is_up;
}

} // namespace

FoundMoment findTime(const CivilSite& site, year_month_day day, const WantedTime& wanted,
                     const std::string& option, bool is_end) {
    if (!spanOf(site.zone, day).is_there)
        return {FoundMoment::Kind::no_day, {}, noDay(site, day), {}};
    if (wanted.since == WantedTime::Since::midnight)
        return byTheClock(site, day, wanted.later, option, is_end);
    return byTheSun(site, day, wanted, option);
}

Daylight daylightOf(const CivilSite& site, year_month_day day, minutes step) {
    const DaySpan span = spanOf(site.zone, day);
    if (!span.is_there)
        return {Daylight::Kind::no_day, {}, {}, noDay(site, day), {}};
    const SunEvents events = eventsOf(site, span, BARE_HORIZON_DEG);
    Daylight light;
    bool is_found = false;
    for (sys_seconds moment = wholeMinute(span.begin); moment < span.end; moment += step) {
        if (!isUp(events, moment))
            continue;
        light.first = is_found ? light.first : moment;
        light.last = moment;
        is_found = true;
    }
    // Steps may be longer than the day is light: the sun is highest at one moment at least.
    const auto highest = std::ranges::find_if(events.events, [&](const SunEvent& event) {
        return event.kind == SunEvent::Kind::transit && isUp(events, event.time);
    });
    if (!is_found && highest != events.events.end()) {
        light.first = light.last = wholeMinute(highest->time);
    } else if (!is_found) {
        light.kind = Daylight::Kind::no_rise;
        light.mistake = "the sun does not rise there on " + dateText(day) +
                        "; give --from and --to, such as 09:00 and 15:00.";
    } else if (events.course == SunEvents::Course::polar_day) {
        light.kind = Daylight::Kind::polar_day;
        light.note = "The sun does not set there on " + dateText(day);
    }
    return light;
}

} // namespace quarn
