#include "host/almanac/StudyCourse.h"

#include "host/almanac/WantedDay.h"
#include "host/clock/WallText.h"
#include "sdk/zel/QnZone.h"

#include <algorithm>

namespace quarn {

namespace {

using namespace std::chrono;

bool isOneDay(const StudyCourse& course) {
    return course.kind == StudyCourse::Kind::one_day;
}

local_seconds onStudyClock(const StudyCourse& course, sys_seconds moment) {
    return local_seconds(moment.time_since_epoch() +
                         hours(QnZoneOfLongitude(studyLongitude(course))));
}

std::string placeNote(const CivilSite& site) {
    const std::string name = site.place.empty() ? "" : site.place + ": ";
    return name + coordinatesText(site);
}

/// "Europe/Berlin, CEST (UTC+2)"; what says the same twice is told once.
std::string zoneNote(const StudyCourse& course) {
    const WallTime first = course.site.zone.at(course.start);
    const std::string offset = offsetText(first);
    std::string text = "Clock: " + course.site.zone.name();
    if (first.abbreviation != course.site.zone.name() && first.abbreviation != offset)
        text += ", " + first.abbreviation;
    if (offset != course.site.zone.name())
        text += " (" + offset + ")";
    return text;
}

std::string firstFrameNote(const StudyCourse& course) {
    const WallTime local = course.site.zone.at(course.start);
    const WallTime universal = Zone::fixed(minutes(0)).at(course.start);
    const bool is_same_date = dateText(universal) == dateText(local);
    return "First frame: " + dateAndTime(local) + " = " +
           (is_same_date ? timeWithZone(universal) : dateAndTime(universal));
}

/// The moments at which the clocks are changed within a study, a day of it or a year apart.
std::vector<std::string> dayChanges(const StudyCourse& course) {
    std::vector<std::string> notes;
    const Zone& zone = course.site.zone;
    WallTime before = zone.at(course.start);
    for (sys_seconds moment = course.start + 1min; moment <= course.end; moment += 1min) {
        const WallTime now = zone.at(moment);
        if (now.offset != before.offset)
            notes.push_back(std::string("Clocks are put ") +
                            (now.offset > before.offset ? "forward" : "back") + " to " +
                            timeWithZone(now) + ", one minute after " + timeWithZone(before));
        before = now;
    }
    return notes;
}

/// A season keeps its time of the clock that never changes.
std::vector<std::string> seasonChanges(const StudyCourse& course) {
    const Zone& zone = course.site.zone;
    const seconds standard = zone.standardOffset(int(dateAt(zone, course.start).year()));
    for (sys_seconds moment = course.start; moment <= course.end; moment += days(course.step)) {
        const WallTime wall = zone.at(moment);
        if (wall.offset == standard)
            continue;
        const WallTime kept{
            local_seconds(moment.time_since_epoch() + standard), standard, {}, false};
        return {"Every frame is at " + timeText(kept) + " of " + offsetText(kept) + ", which is " +
                timeWithZone(wall) + " while clocks are put forward"};
    }
    return {};
}

/// The page that the recording writes knows the set-up commands' clock alone.
std::vector<std::string> pageNote(const StudyCourse& course) {
    const hours zone(QnZoneOfLongitude(studyLongitude(course)));
    if (course.site.zone.at(course.start).offset == zone)
        return {};
    return {"The recording's own page tells times by " + offsetText(WallTime{{}, zone, {}, false}) +
            ", the whole hours of the longitude"};
}

} // namespace

int frameCount(const StudyCourse& course) {
    const seconds step =
        isOneDay(course) ? seconds(minutes(course.step)) : seconds(days(course.step));
    return static_cast<int>((course.end - course.start) / step) + 1;
}

double studyLongitude(const StudyCourse& course) {
    const double longitude_deg = course.site.longitude_deg;
    return isOneDay(course) ? longitude_deg : eastwardLongitude(longitude_deg);
}

std::vector<StudySpan> studySpans(const StudyCourse& course) {
    if (!isOneDay(course))
        return {{onStudyClock(course, course.start), onStudyClock(course, course.end)}};
    std::vector<StudySpan> spans;
    const minutes step(course.step);
    for (sys_seconds moment = course.start; moment <= course.end;) {
        const local_seconds first = onStudyClock(course, moment);
        const local_seconds midnight = floor<days>(first) + days(1);
        const local_seconds last = std::min(onStudyClock(course, course.end), midnight - 1min);
        spans.push_back({first, last});
        moment += step * ((last - first) / step + 1);
    }
    return spans;
}

std::vector<std::string> studyNotes(const StudyCourse& course) {
    std::vector<std::string> notes = {placeNote(course.site), zoneNote(course),
                                      firstFrameNote(course)};
    const auto changes = isOneDay(course) ? dayChanges(course) : seasonChanges(course);
    for (const auto& more : {course.notes, changes, pageNote(course)})
        notes.insert(notes.end(), more.begin(), more.end());
    return notes;
}

} // namespace quarn
