#include "host/session/StudiedSite.h"

#include "host/cities/LocationChoice.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <cmath>

namespace quarn {

namespace {

KM_3dmAnimationProperties recordOf(Document& document) {
    return Zoetrix_QuarnDynamicAccess() ? document.properties().AnimationProperties()
                                        : KM_3dmAnimationProperties();
}

/// What a file holds may be no place.
Place placeOf(const KM_3dmAnimationProperties& record) {
    const double longitude_deg = std::remainder(record.Longitude(), 360.0);
    if (!(std::abs(record.Latitude()) <= 90.0) || !(std::abs(record.Longitude()) <= 360.0))
        return {};
    return {record.Latitude(),
            std::abs(record.Longitude()) <= 180.0 ? record.Longitude() : longitude_deg};
}

void keepInRecord(Document& document, const StudiedSite& site) {
    KM_3dmAnimationProperties record = document.properties().AnimationProperties();
    record.SetLatitude(site.latitude_deg);
    record.SetLongitude(site.longitude_deg);
    record.SetNorthAngle(site.north_deg);
    document.properties().SetAnimationProperties(record);
}

} // namespace

StudiedSite studiedSite(CQuarnDoc& document) {
    Document& whole = Document::of(document);
    const KM_3dmAnimationProperties record = recordOf(whole);
    const Place place = placeOf(record);
    StudiedSite site{{}, {}, place.latitude_deg, place.longitude_deg, 0.0};
    if (std::abs(record.NorthAngle()) <= 360.0)
        site.north_deg = record.NorthAngle();
    const std::optional<StudiedPlace> kept = whole.studiedPlace();
    if (kept && kept->isAt(record.Latitude(), record.Longitude())) {
        site.city = kept->city.ToUtf8();
        site.zone = kept->zone.ToUtf8();
    }
    const City* const here = LocationChoice(place).cityHere();
    if (site.city.empty() && here)
        site.city = nameWithCountry(*here);
    return site;
}

void keepStudiedSite(CQuarnDoc& document, const StudiedSite& site) {
    Document& whole = Document::of(document);
    if (!Zoetrix_QuarnDynamicAccess() || recordOf(whole).IsSunStudy())
        return;
    keepInRecord(whole, site);
    whole.setStudiedPlace({KM_wString::FromUtf8(site.city), KM_wString::FromUtf8(site.zone),
                           site.latitude_deg, site.longitude_deg});
}

} // namespace quarn
