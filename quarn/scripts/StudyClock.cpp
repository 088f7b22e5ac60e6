#include "quarn/scripts/StudyClock.h"

#include "sdk/zel/QnZone.h"

namespace quarn::program {

namespace {

std::string placeNote(const StudySite& site) {
    const std::string name = site.place.empty() ? "" : site.place + ": ";
    return name + latitudeText(site.latitude_deg) + ", " + longitudeText(site.longitude_deg);
}

std::string zoneText(int hours) {
    return QnZoneText(60 * hours).ToUtf8();
}

/// A western place counted eastward is a day ahead of its own hours.
std::string zoneNote(const SunStudyRequest& request) {
    const double longitude_deg = studyLongitude(request);
    const int hours = QnZoneOfLongitude(longitude_deg);
    const std::string note = "Clock: " + zoneText(hours) + ", the whole hours of longitude " +
                             longitudeText(longitude_deg) + ", without daylight saving";
    if (longitude_deg == request.site.longitude_deg)
        return note;
    return note + ": the hour of " + zoneText(hours - 24) + " with the next day's date";
}

std::string firstFrameNote(const SunStudyRequest& request) {
    const COleDateTime& start = request.start;
    COleDateTime universal = start;
    universal += COleDateTimeSpan(0, -QnZoneOfLongitude(studyLongitude(request)), 0, 0);
    const bool is_same_date = dateText(universal) == dateText(start);
    return "First frame: " + dateText(start) + " " + timeOfDayText(start) + " = " +
           (is_same_date ? "" : dateText(universal) + " ") + timeOfDayText(universal) + " UTC";
}

} // namespace

double studyLongitude(const SunStudyRequest& request) {
    const double longitude_deg = request.site.longitude_deg;
    return request.kind == SunStudyRequest::Kind::seasonal ? eastwardLongitude(longitude_deg)
                                                           : longitude_deg;
}

std::vector<std::string> studyNotes(const SunStudyRequest& request) {
    return {placeNote(request.site), zoneNote(request), firstFrameNote(request)};
}

} // namespace quarn::program
