#include "quarn/scripts/StudyDay.h"

#include "host/clock/WallText.h"
#include "host/sun/Seasons.h"
#include "host/sun/SunEvents.h"
#include "quarn/words/DateWords.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace quarn::program {

namespace {

using namespace std::chrono;
using Kind = WallReading::Kind;

std::string textOf(year_month_day day) {
    return dateText(WallTime{local_days(day), {}, {}, false});
}

sys_seconds seasonMoment(SeasonDay day, int of_year) {
    const Seasons seasons = seasonsOf(of_year);
    switch (day) {
    case SeasonDay::march_equinox:
        return seasons.march_equinox;
    case SeasonDay::june_solstice:
        return seasons.june_solstice;
    case SeasonDay::september_equinox:
        return seasons.september_equinox;
    case SeasonDay::december_solstice:
        break;
    }
    return seasons.december_solstice;
}

year_month_day dateIn(const Zone& zone, sys_seconds moment) {
    return year_month_day{floor<days>(zone.at(moment).local)};
}

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
    span.is_there = dateIn(zone, span.begin) == day;
    return span;
}

SunEvents eventsOf(const StudySite& site, const DaySpan& span, double horizon_deg) {
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

std::string noDay(const StudySite& site, year_month_day day) {
    return "the date " + textOf(day) + " does not exist in " + site.zone.name() +
           ": clocks were put over it.";
}

FoundMoment byTheClock(const StudySite& site, year_month_day day, minutes time,
                       const std::string& option, bool is_end) {
    const local_seconds local = local_days(day) + time;
    const WallReading reading = site.zone.read(local);
    const std::string shown = timeText(WallTime{local, {}, {}, false}) + " on " + textOf(day);
    if (reading.kind == Kind::skipped)
        return {{},
                option + " " + shown + " does not exist in " + site.zone.name() +
                    ": clocks go until " + skippedText(site.zone, reading.first) + ".",
                {}};
    FoundMoment found{wholeMinute(is_end ? reading.second : reading.first), {}, {}};
    if (reading.kind == Kind::twice)
        found.note = shown + " comes twice: " + option + " takes the " +
                     (is_end ? "second" : "first") + ", " + timeWithZone(site.zone.at(found.time));
    return found;
}

FoundMoment byTheSun(const StudySite& site, year_month_day day, const WantedTime& wanted,
                     const std::string& option) {
    const bool is_rise = wanted.since == WantedTime::Since::sunrise;
    const SunEvents events = eventsOf(site, spanOf(site.zone, day), PUBLISHED_HORIZON_DEG);
    const auto event = events.first(is_rise ? SunEvent::Kind::rise : SunEvent::Kind::set);
    if (!event)
        return {{},
                option + ": the sun does not " + (is_rise ? "rise" : "set") + " there on " +
                    textOf(day) + "; give a time such as 09:00.",
                {}};
    return {wholeMinute(*event + wanted.later), {}, {}};
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

year_month_day dayOf(const WantedDay& wanted, const Zone& zone) {
    if (const auto* const day = std::get_if<year_month_day>(&wanted))
        return *day;
    const year_month_day today = dateIn(zone, floor<seconds>(system_clock::now()));
    if (const auto* const season = std::get_if<SeasonDay>(&wanted))
        return dateIn(zone, seasonMoment(*season, int(today.year())));
    return today;
}

std::optional<WantedTime> wantedTime(std::string_view word) {
    if (const auto clock = clockTime(word))
        return WantedTime{WantedTime::Since::midnight, hours(clock->hour) + minutes(clock->minute)};
    const bool is_rise = word.starts_with("sunrise");
    if (!is_rise && !word.starts_with("sunset"))
        return std::nullopt;
    WantedTime wanted{is_rise ? WantedTime::Since::sunrise : WantedTime::Since::sunset};
    word.remove_prefix(is_rise ? 7 : 6);
    if (word.empty())
        return wanted;
    const int sign = word.front() == '-' ? -1 : 1;
    if (word.size() < 3 || (word.front() != '+' && word.front() != '-'))
        return std::nullopt;
    word.remove_prefix(1);
    constexpr minutes HOUR{60};
    for (const auto& [unit, size] : {std::pair{'h', HOUR}, std::pair{'m', minutes(1)}}) {
        const std::size_t end = word.find(unit);
        if (end == std::string_view::npos)
            continue;
        unsigned number = 0;
        const auto read = std::from_chars(word.data(), word.data() + end, number);
        if (end == 0 || end > 3 || read.ptr != word.data() + end)
            return std::nullopt;
        wanted.later += sign * static_cast<int>(number) * size;
        word.remove_prefix(end + 1);
    }
    constexpr hours HALF_A_DAY{12};
    if (!word.empty() || abs(wanted.later) >= HALF_A_DAY)
        return std::nullopt;
    return wanted;
}

FoundMoment findTime(const StudySite& site, year_month_day day, const WantedTime& wanted,
                     const std::string& option, bool is_end) {
    if (!spanOf(site.zone, day).is_there)
        return {{}, noDay(site, day), {}};
    if (wanted.since == WantedTime::Since::midnight)
        return byTheClock(site, day, wanted.later, option, is_end);
    return byTheSun(site, day, wanted, option);
}

Daylight daylightOf(const StudySite& site, year_month_day day, minutes step) {
    const DaySpan span = spanOf(site.zone, day);
    if (!span.is_there)
        return {{}, {}, noDay(site, day), {}};
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
    if (!is_found && highest != events.events.end())
        light.first = light.last = wholeMinute(highest->time);
    else if (!is_found)
        light.mistake = "the sun does not rise there on " + textOf(day) +
                        "; give --from and --to, such as 09:00 and 15:00.";
    else if (events.course == SunEvents::Course::polar_day)
        light.note = "The sun does not set there on " + textOf(day);
    return light;
}

} // namespace quarn::program
