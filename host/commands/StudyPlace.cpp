#include "host/commands/StudyPlace.h"

#include "host/commands/SunText.h"
#include "host/document/Document.h"
#include "import/ImportedModel.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

bool hasPlace(const KM_3dmAnimationProperties& record) {
    const KM_3dmAnimationProperties fresh;
    return record.IsSunStudy() || record.Latitude() != fresh.Latitude() ||
           record.Longitude() != fresh.Longitude() || record.NorthAngle() != fresh.NorthAngle();
}

} // namespace

std::string offerStudyPlace(Document& document, const ImportedPlace& place) {
    if (!Zoetrix_QuarnDynamicAccess())
        return {};
    KM_3dmAnimationProperties record = document.properties().AnimationProperties();
    if (hasPlace(record))
        return {};
    record.SetLatitude(place.latitude_deg);
    record.SetLongitude(place.longitude_deg);
    record.SetNorthAngle(place.north_angle_deg);
    document.properties().SetAnimationProperties(record);
    return KM_wString::FormatToString(
               QnLocalizeString(L"Sun studies begin with the place that the file states: latitude "
                                L"%s, longitude %s, north angle %s.",
                                42665),
               angleText(place.latitude_deg).Array(), angleText(place.longitude_deg).Array(),
               angleText(place.north_angle_deg).Array())
        .ToUtf8();
}

} // namespace quarn
