#include "host/commands/SunForm.h"

#include "host/commands/FormAsking.h"
#include "host/prompt/NumberText.h"
#include "host/prompt/UsersNumber.h"
#include "host/sun/SunDirection.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnLocationDialog.h"
#include "sdk/zel/QnZone.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace quarn {

namespace {

constexpr int LOCATION_CHOSEN = 1;
constexpr double MOST_HOURS = 24.0;

bool areSame(const SunPosition& one, const SunPosition& other) {
    return one.azimuth_deg == other.azimuth_deg && one.altitude_deg == other.altitude_deg;
}

bool areSame(const PlaceAndTime& one, const PlaceAndTime& other) {
    return one.site.latitude_deg == other.site.latitude_deg &&
           one.site.longitude_deg == other.site.longitude_deg &&
           one.clock.time == other.clock.time &&
           one.clock.zone_minutes == other.clock.zone_minutes &&
           one.north_angle_deg == other.north_angle_deg;
}

/// An azimuth from 0 up to but not including 360.
double turnedOnce(double azimuth_deg) {
    const double turned = std::fmod(azimuth_deg, 360);
    return turned < 0 ? turned + 360 : turned;
}

} // namespace

SunForm::SunForm(const DocumentSun& sun, const PlaceAndTime& offered)
    : CDialog(form_id, nullptr), m_present(positionOfSun(sun.directionToSun())),
      m_position(m_present), m_known_position(m_present), m_entered(offered), m_known(offered),
      m_is_enabled(sun.isEnabled()) {
    AttachComboBox(sun_id, m_sun);
}

std::optional<SunPosition> SunForm::movedTo() const {
    return areSame(m_position, m_present) ? std::nullopt : std::optional(m_position);
}

int SunForm::OnInitDialog() {
    m_sun.InsertString(on, QnLocalizeString(L"On", 42457));
    m_sun.InsertString(off, QnLocalizeString(L"Off", 42458));
    m_sun.SetCurSel(m_is_enabled ? on : off);
    return CDialog::OnInitDialog();
}

void SunForm::DoDataExchange(CQnDialogExchange& exchange) {
    if (exchange.IsStoring())
        m_is_enabled = m_sun.GetCurSel() == on;
    exchangePlaceAndTime(exchange);
    exchangeRounded(exchange, azimuth_id, m_position.azimuth_deg,
                    roundedAngle(m_position.azimuth_deg));
    DDV_MinMaxDouble(exchange, m_position.azimuth_deg, -360, 360);
    exchangeRounded(exchange, altitude_id, m_position.altitude_deg,
                    roundedAngle(m_position.altitude_deg));
    DDV_MinMaxDouble(exchange, m_position.altitude_deg, -90, 90);
}

void SunForm::exchangePlaceAndTime(CQnDialogExchange& exchange) {
    SunSite& site = m_entered.site;
    exchangeRounded(exchange, latitude_id, site.latitude_deg, roundedAngle(site.latitude_deg));
    DDV_MinMaxDouble(exchange, site.latitude_deg, -90, 90);
    exchangeRounded(exchange, longitude_id, site.longitude_deg, roundedAngle(site.longitude_deg));
    DDV_MinMaxDouble(exchange, site.longitude_deg, -180, 180);
    DDX_DateTimeCtrl(exchange, date_id, m_entered.clock.time);
    DDX_DateTimeCtrl(exchange, time_id, m_entered.clock.time);
    exchangeZone(exchange);
    DDX_Text(exchange, north_angle_id, m_entered.north_angle_deg);
    DDV_MinMaxDouble(exchange, m_entered.north_angle_deg, -360, 360);
    if (exchange.IsStoring() && !exchange.HasFailed() && !sunPositionAt(site, m_entered.clock))
        exchange.Fail(
            date_id,
            QnLocalizeString(L"The sun has no known position for this place and time.", 42459));
}

/// The zone of the longitude is an empty field, so that it follows when the place is changed.
void SunForm::exchangeZone(CQnDialogExchange& exchange) {
    int& zone_minutes = m_entered.clock.zone_minutes;
    const int usual_minutes = 60 * QnZoneOfLongitude(m_entered.site.longitude_deg);
    if (!exchange.IsStoring()) {
        SetDlgItemText(zone_id, zone_minutes == usual_minutes ? KM_wString()
                                                              : numberText(zone_minutes / 60.0));
        return;
    }
    const std::wstring text(GetDlgItemText(zone_id).View());
    if (std::ranges::all_of(text, [](wchar_t letter) { return letter == L' '; })) {
        zone_minutes = usual_minutes;
        return;
    }
    double hours = 0.0;
    DDX_Text(exchange, zone_id, hours);
    DDV_MinMaxDouble(exchange, hours, -MOST_HOURS, MOST_HOURS);
    if (!exchange.HasFailed())
        zone_minutes = static_cast<int>(std::lround(hours * 60));
}

void SunForm::OnButton(int control) {
    if (control == location_button_id)
        chooseLocation();
    else if (control == compute_button_id && UpdateData(true))
        compute();
}

/// Begins with what stands in the fields, where that is a place.
void SunForm::chooseLocation() {
    const auto entered = [this](int control, double otherwise) {
        return readUsersNumber(std::wstring(GetDlgItemText(control).View())).value_or(otherwise);
    };
    SunSite site = m_entered.site;
    double latitude_deg = entered(latitude_id, site.latitude_deg);
    double longitude_deg = entered(longitude_id, site.longitude_deg);
    if (QnShowLocationDialog(QnLocalizeString(L"Sun", 42320), latitude_deg, longitude_deg) !=
        LOCATION_CHOSEN)
        return;
    m_entered.site = {latitude_deg, longitude_deg};
    SetDlgItemText(latitude_id, numberText(roundedAngle(latitude_deg)));
    SetDlgItemText(longitude_id, numberText(roundedAngle(longitude_deg)));
}

/// Puts the sun where it stands at the place and time; the exchange made sure that it is known.
void SunForm::compute() {
    const auto position = sunPositionAt(m_entered.site, m_entered.clock);
    if (!position)
        return;
    m_position = {turnedOnce(position->azimuth_deg + m_entered.north_angle_deg),
                  position->altitude_deg};
    m_known_position = m_position;
    m_known = m_entered;
    m_is_by_place_and_time = true;
    UpdateData(false);
}

/// A place and time that were changed behind the last look at the angles count; angles that the
/// person entered count in any case.
void SunForm::OnOK() {
    if (!UpdateData(true))
        return;
    if (!areSame(m_position, m_known_position))
        m_is_by_place_and_time = false;
    else if (!areSame(m_entered, m_known))
        compute();
    EndDialog(1);
}

} // namespace quarn
