#include "quarn/scripts/StudyClock.h"

#include "host/clock/WallText.h"
#include "sdk/zel/QnZone.h"

#include <algorithm>

namespace quarn::program {

namespace {

using namespace std::chrono;

bool isOneDay(const SunStudyRequest& request) {
    return request.kind == SunStudyRequest::Kind::one_day;
}

int yearOf(const WallTime& wall) {
    return int(year_month_day{floor<days>(wall.local)}.year());
}

local_seconds onStudyClock(const SunStudyRequest& request, sys_seconds moment) {
    return local_seconds(moment.time_since_epoch() +
                         hours(QnZoneOfLongitude(studyLongitude(request))));
}

std::string placeNote(const StudySite& site) {
    const std::string name = site.place.empty() ? "" : site.place + ": ";
    return name + latitudeText(site.latitude_deg) + ", " + longitudeText(site.longitude_deg);
}

/// "Europe/Berlin, CEST (UTC+2)"; what says the same twice is told once.
std::string zoneNote(const SunStudyRequest& request) {
    const WallTime first = request.site.zone.at(request.start);
    const std::string offset = offsetText(first);
    std::string text = "Clock: " + request.site.zone.name();
    if (first.abbreviation != request.site.zone.name() && first.abbreviation != offset)
        text += ", " + first.abbreviation;
    if (offset != request.site.zone.name())
        text += " (" + offset + ")";
    return text;
}

std::string firstFrameNote(const SunStudyRequest& request) {
    const WallTime local = request.site.zone.at(request.start);
    const WallTime universal = Zone::fixed(minutes(0)).at(request.start);
    const bool is_same_date = dateText(universal) == dateText(local);
    return "First frame: " + dateAndTime(local) + " = " +
           (is_same_date ? timeWithZone(universal) : dateAndTime(universal));
}

/// The moments at which the clocks are changed within a study, a day of it or a year apart.
std::vector<std::string> dayChanges(const SunStudyRequest& request) {
    std::vector<std::string> notes;
    const Zone& zone = request.site.zone;
    WallTime before = zone.at(request.start);
    for (sys_seconds moment = request.start + 1min; moment <= request.end; moment += 1min) {
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
std::vector<std::string> seasonChanges(const SunStudyRequest& request) {
    const Zone& zone = request.site.zone;
    const seconds standard = zone.standardOffset(yearOf(zone.at(request.start)));
    for (sys_seconds moment = request.start; moment <= request.end; moment += days(request.step)) {
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
std::vector<std::string> pageNote(const SunStudyRequest& request) {
    const hours zone(QnZoneOfLongitude(studyLongitude(request)));
    if (request.site.zone.at(request.start).offset == zone)
        return {};
    return {"The recording's own page tells times by " + offsetText(WallTime{{}, zone, {}, false}) +
            ", the whole hours of the longitude"};
}

} // namespace

double studyLongitude(const SunStudyRequest& request) {
    const double longitude_deg = request.site.longitude_deg;
    return isOneDay(request) ? longitude_deg : eastwardLongitude(longitude_deg);
}

std::vector<StudySpan> studySpans(const SunStudyRequest& request) {
    if (!isOneDay(request))
        return {{onStudyClock(request, request.start), onStudyClock(request, request.end)}};
    std::vector<StudySpan> spans;
    const minutes step(request.step);
    for (sys_seconds moment = request.start; moment <= request.end;) {
        const local_seconds first = onStudyClock(request, moment);
        const local_seconds midnight = floor<days>(first) + days(1);
        const local_seconds last = std::min(onStudyClock(request, request.end), midnight - 1min);
        spans.push_back({first, last});
        moment += step * ((last - first) / step + 1);
    }
    return spans;
}

std::vector<std::string> studyNotes(const SunStudyRequest& request) {
    std::vector<std::string> notes = {placeNote(request.site), zoneNote(request),
                                      firstFrameNote(request)};
    const auto changes = isOneDay(request) ? dayChanges(request) : seasonChanges(request);
    for (const auto& more : {request.notes, changes, pageNote(request)})
        notes.insert(notes.end(), more.begin(), more.end());
    return notes;
}

} // namespace quarn::program
