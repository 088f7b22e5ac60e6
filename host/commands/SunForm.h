#pragma once

#include "host/document/DocumentSun.h"
#include "sdk/qncore/QnComboBox.h"
#include "sdk/qncore/QnDialog.h"

#include <optional>

namespace quarn {

/// Asks whether the sun shines and where it stands. A place and time give its azimuth and altitude,
/// by a button, and without it where they were changed last. A button lets the person choose the
/// place on a map.
class SunForm final : public CDialog {
public:
    static constexpr int form_id = 4203;
    enum control_id : int {
        sun_id = 4301,
        latitude_id = 4302,
        longitude_id = 4303,
        location_button_id = 4304,
        date_id = 4305,
        time_id = 4306,
        zone_id = 4307,
        north_angle_id = 4308,
        compute_button_id = 4309,
        azimuth_id = 4310,
        altitude_id = 4311,
    };
    enum state : int { on = 0, off = 1 };

    /// @param offered  the place and time that are shown first
    SunForm(const DocumentSun& sun, const PlaceAndTime& offered);

    bool isEnabled() const { return m_is_enabled; }
    /// Where the sun is to stand, clockwise from the Y axis; nothing where it is to stay.
    std::optional<SunPosition> movedTo() const;
    const PlaceAndTime& placeAndTime() const { return m_entered; }
    /// Whether movedTo() is where the sun stands at placeAndTime().
    bool isByPlaceAndTime() const { return m_is_by_place_and_time; }

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    int OnInitDialog() override;
    void OnOK() override;
    void OnButton(int control) override;

private:
    void exchangePlaceAndTime(CQnDialogExchange& exchange);
    void exchangeZone(CQnDialogExchange& exchange);
    void chooseLocation();
    void compute();

    const SunPosition m_present;
    SunPosition m_position;
    SunPosition m_known_position; ///< as the fields had it before the person changed them
    PlaceAndTime m_entered;
    PlaceAndTime m_known; ///< likewise
    bool m_is_enabled;
    bool m_is_by_place_and_time = false;
    CComboBox m_sun;
};

} // namespace quarn
