#include "host/app/StudyMoments.h"

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

double turned(double degrees) {
    const double rest = std::fmod(degrees, 360.0);
    return rest < 0.0 ? rest + 360.0 : rest;
}

} // namespace

std::optional<FrameSun> sunOfFrame(const KM_3dmAnimationProperties& record, int frame) {
    const KM_3dPoint* const tip = record.CameraPoints().At(frame);
    const KM_3dPoint* const origin = record.TargetPoints().At(frame);
    if (!record.IsSunStudy() || !tip || !origin || frame >= record.Dates().Count())
        return std::nullopt;
    std::string time = record.Dates()[frame].ToUtf8();
    KM_3dVector toward_sun = *tip - *origin;
    if (!isDateTime(time) || !toward_sun.Unitize())
        return std::nullopt;
    time[time.find(' ')] = 'T';
    // Azimuths run from north, which lies the north angle clockwise of the Y axis.
    const double from_y = std::atan2(toward_sun.x, toward_sun.y) * DEGREES_PER_RADIAN;
    const double altitude = std::asin(std::clamp(toward_sun.z, -1.0, 1.0)) * DEGREES_PER_RADIAN;
    return FrameSun{time, QnZoneText(60 * QnZoneOfLongitude(record.Longitude())).ToUtf8(),
                    turned(from_y - record.NorthAngle()), altitude};
}

} // namespace quarn
