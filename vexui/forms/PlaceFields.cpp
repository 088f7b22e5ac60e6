#include "vexui/forms/PlaceFields.h"

#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnLocationDialog.h"
#include "sdk/zel/QnZone.h"
#include "vexui/forms/NumberField.h"
#include "vexui/texts/LocalText.h"

#include <QLabel>
#include <QLineEdit>

#include <cmath>

namespace vexui {

namespace {

/// The same longitude from -180 to 180 degrees.
double inRange(double longitude) {
    return std::abs(longitude) <= 180.0 ? longitude : std::remainder(longitude, 360.0);
}

/// Nobody points at a place more exactly than to some ten metres.
double rounded(double degrees) {
    constexpr double parts = 10000.0;
    return std::round(degrees * parts) / parts;
}

} // namespace

void PlaceFields::show(const KM_3dmAnimationProperties& record) const {
    latitude->setNumber(record.Latitude());
    longitude->setNumber(inRange(record.Longitude()));
    north_angle->setNumber(record.NorthAngle());
}

std::optional<QnSunStudyPlace> PlaceFields::place() const {
    if (!latitude->number() || !longitude->number())
        return std::nullopt;
    return QnSunStudyPlace{*latitude->number(), *longitude->number(), fromQt(clocks->text())};
}

void PlaceFields::followPlace() const {
    std::optional<QnSunStudyPlace> here = place();
    city->setText(here ? toQt(QnCityOfSunStudy(*here)) : QString());
    if (!here)
        return;
    here->clocks = {};
    const QString of_place = toQt(QnClocksOfSunStudy(*here));
    clocks->setPlaceholderText(of_place);
    if (!has_own_clocks && !clocks->hasFocus()) // nobody empties it to type another one
        clocks->setText(of_place);
}

void PlaceFields::choose() const {
    double chosen_latitude = latitude->number().value_or(0.0);
    double chosen_longitude = longitude->number().value_or(0.0);
    if (QnShowLocationDialog(QnLocalizeString(L"Set Animation Location", 34509), chosen_latitude,
                             chosen_longitude) != QnDialogConfirmed)
        return;
    latitude->setNumber(rounded(chosen_latitude));
    longitude->setNumber(rounded(inRange(chosen_longitude)));
}

void PlaceFields::tellZone() const {
    const std::optional<double> degrees = longitude->number();
    zone->setText(degrees ? localText(L"Times are those of %1, without daylight saving.", 44110)
                                .arg(toQt(QnZoneText(60 * QnZoneOfLongitude(*degrees))))
                          : QString());
}

void PlaceFields::takeInto(KM_3dmAnimationProperties& record) const {
    record.SetLatitude(latitude->number().value_or(0.0));
    record.SetLongitude(longitude->number().value_or(0.0));
    record.SetNorthAngle(north_angle->number().value_or(0.0));
    if (const std::optional<QnSunStudyPlace> here = place())
        QnKeepPlaceOfSunStudy(*here);
}

QString PlaceFields::latitudeFault() const {
    return latitude->number() ? QString()
                              : localText(L"Enter a latitude from -90 to 90 degrees.", 44072);
}

QString PlaceFields::longitudeFault() const {
    return longitude->number() ? QString()
                               : localText(L"Enter a longitude from -180 to 180 degrees.", 44073);
}

QString PlaceFields::northAngleFault() const {
    return north_angle->number()
               ? QString()
               : localText(L"Enter a north angle from -360 to 360 degrees.", 44074);
}

QString PlaceFields::clocksFault() const {
    const std::optional<QnSunStudyPlace> here = place();
    if (!here || here->clocks.IsEmpty() || !QnClocksOfSunStudy(*here).IsEmpty())
        return {};
    return localText(L"There is no such time zone. Enter one as Europe/Berlin, +05:30 or solar.",
                     44125);
}

} // namespace vexui
