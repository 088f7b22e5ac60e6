#include "host/almanac/CourseChoice.h"

#include "host/clock/WallText.h"
#include "host/sun/SunYears.h"

namespace quarn {

namespace {

using namespace std::chrono;

/// An end of a day: where it was not asked for, the first or last light.
FoundMoment endOf(const StudyCourse& course, year_month_day day,
                  const std::optional<WantedTime>& wanted, bool is_end) {
    if (wanted)
        return findTime(course.site, day, *wanted, is_end ? "--to" : "--from", is_end);
    const Daylight light = daylightOf(course.site, day, minutes(course.step));
    return {FoundMoment::Kind::found, is_end ? light.last : light.first, light.mistake,
            is_end ? "" : light.note};
}

/// The same date of another year; the day before it where that has no 29 February.
year_month_day yearsLater(year_month_day day, int more) {
    const auto later = day + years(more);
    return later.ok() ? later : later.year() / later.month() / last;
}

/// The clock of the set-up commands may be a day before or behind at the ends of their years.
Result<StudyCourse> withinYears(StudyCourse course) {
    const bool is_one_day = course.kind == StudyCourse::Kind::one_day;
    const int last_year = is_one_day ? LAST_SUN_YEAR : LAST_SEASON_YEAR;
    for (const StudySpan& span : studySpans(course))
        for (const local_seconds end : {span.first, span.last}) {
            const int of_year = int(year_month_day{floor<days>(end)}.year());
            if (of_year < FIRST_SUN_YEAR || of_year > last_year)
                return Error{"the study reaches beyond the years " +
                             std::to_string(FIRST_SUN_YEAR) + " to " + std::to_string(last_year) +
                             " by the sun's own clock; leave out its first or last day."};
        }
    return course;
}

struct SeasonDates {
    year_month_day first;
    year_month_day last;
};

SeasonDates datesOf(const Zone& zone, const std::optional<year_month_day>& first,
                    const std::optional<year_month_day>& last) {
    if (!first && !last) {
        const year this_year = today(zone).year();
        return {this_year / January / 1, this_year / December / 31};
    }
    const year_month_day known = first ? *first : *last;
    return {first.value_or(sys_days(yearsLater(known, -1)) + days(1)),
            last.value_or(sys_days(yearsLater(known, 1)) - days(1))};
}

} // namespace

Result<StudyCourse> courseOfDay(const CivilSite& site, const WantedCourse& wanted,
                                int step_minutes) {
    StudyCourse course{StudyCourse::Kind::one_day, site, {}, {}, step_minutes, {}};
    const year_month_day day = dayOf(wanted.day, site.zone);
    const FoundMoment first = endOf(course, day, wanted.first, false);
    const FoundMoment last = endOf(course, day, wanted.last, true);
    for (const FoundMoment& found : {first, last}) {
        if (!found.mistake.empty())
            return Error{found.mistake};
        if (!found.note.empty())
            course.notes.push_back(found.note);
    }
    course.start = first.time;
    course.end = last.time;
    if (course.end < course.start)
        return Error{"--to " + timeWithZone(site.zone.at(course.end)) + " is before --from " +
                     timeWithZone(site.zone.at(course.start)) + "."};
    return withinYears(std::move(course));
}

Result<StudyCourse> courseOfSeason(const CivilSite& site, std::optional<year_month_day> first,
                                   std::optional<year_month_day> last, minutes time,
                                   int step_days) {
    const SeasonDates dates = datesOf(site.zone, first, last);
    if (dates.last < dates.first)
        return Error{"--to " + dateText(dates.last) + " is before --from " + dateText(dates.first) +
                     "."};
    const seconds standard = site.zone.standardOffset(int(dates.first.year()));
    const auto momentOf = [&](year_month_day day) {
        return ceil<minutes>(sys_days(day) + time - standard - 30s);
    };
    return withinYears({StudyCourse::Kind::seasonal,
                        site,
                        momentOf(dates.first),
                        momentOf(dates.last),
                        step_days,
                        {}});
}

} // namespace quarn
