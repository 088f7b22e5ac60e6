#include "host/app/StudyMoments.h"

#include "host/clock/WallText.h"
#include "host/document/Document.h"
#include "host/sun/CalendarDay.h"
#include "sdk/zel/QnZone.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

constexpr double DEGREES_PER_RADIAN = 180.0 / std::numbers::pi;

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

/// Labels are texts such as "2026-06-21 14:30:00", but a record may come from anywhere.
bool isDateTime(const std::string& label) {
    constexpr std::string_view form = "0000-00-00 00:00:00";
    return label.size() == form.size() &&
           std::equal(label.begin(), label.end(), form.begin(), [](char character, char wanted) {
               return wanted == '0' ? isDigit(character) : character == wanted;
           });
}

/// What a label says, as a moment; nothing for a day that the calendar does not have.
std::optional<std::chrono::sys_seconds> momentOf(const std::string& label, int zone_hours) {
    using namespace std::chrono;
    const auto number = [&](std::size_t begin, std::size_t count) {
        return std::stoi(label.substr(begin, count));
    };
    const auto day = calendarDay(number(0, 4), number(5, 2), number(8, 2));
    if (!day)
        return std::nullopt;
    return *day + hours(number(11, 2) - zone_hours) + minutes(number(14, 2)) +
           seconds(number(17, 2));
}

/// When a frame is, and by which clock.
struct ToldTime {
    std::string time;
    std::string zone;
};

ToldTime toldTime(std::string label, double longitude_deg, const std::optional<Zone>& zone) {
    const int hours = QnZoneOfLongitude(longitude_deg);
    if (const auto moment = zone ? momentOf(label, hours) : std::nullopt) {
        const WallTime wall = zone->at(*moment);
        return {isoText(wall), wall.abbreviation};
    }
    label[label.find(' ')] = 'T';
    return {label, QnZoneText(60 * hours).ToUtf8()};
}

double turned(double degrees) {
    const double rest = std::fmod(degrees, 360.0);
    return rest < 0.0 ? rest + 360.0 : rest;
}

} // namespace

std::optional<Zone> studyZone(const Document& document, const KM_3dmAnimationProperties& record) {
    const std::optional<StudiedPlace> place = document.studiedPlace();
    if (!place || !place->isAt(record.Latitude(), record.Longitude()))
        return std::nullopt;
    // Without the time zone database a recording goes on, told by the clock that needs none.
    const auto zone = Zone::written(place->zone.ToUtf8(), place->longitude_deg);
    return zone ? std::optional(zone.value()) : std::nullopt;
}

std::optional<FrameSun> sunOfFrame(const KM_3dmAnimationProperties& record, int frame,
                                   const std::optional<Zone>& zone) {
    const KM_3dPoint* const tip = record.CameraPoints().At(frame);
    const KM_3dPoint* const origin = record.TargetPoints().At(frame);
    if (!record.IsSunStudy() || !tip || !origin || frame >= record.Dates().Count())
        return std::nullopt;
    const std::string label = record.Dates()[frame].ToUtf8();
    KM_3dVector toward_sun = *tip - *origin;
    if (!isDateTime(label) || !toward_sun.Unitize())
        return std::nullopt;
    // Azimuths run from north, which lies the north angle clockwise of the Y axis.
    const double from_y = std::atan2(toward_sun.x, toward_sun.y) * DEGREES_PER_RADIAN;
    const double altitude = std::asin(std::clamp(toward_sun.z, -1.0, 1.0)) * DEGREES_PER_RADIAN;
    const ToldTime told = toldTime(label, record.Longitude(), zone);
    return FrameSun{told.time, told.zone, turned(from_y - record.NorthAngle()), altitude};
}

} // namespace quarn
