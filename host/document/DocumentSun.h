#pragma once

#include "host/sun/ClockTime.h"
#include "kelmar/KM_Light.h"
#include "sdk/qncore/QnSun.h"

#include <optional>
#include <vector>

namespace quarn {

/// Where and when a sun is looked at.
struct PlaceAndTime {
    SunSite site{};
    ClockTime clock;
    double north_angle_deg = 0; ///< from the Y axis to north, clockwise seen from above
};

/// The sun of a document. A new one is on and stands in the south-east, halfway up: azimuth 135
/// degrees clockwise from north (+Y), altitude 45 degrees.
class DocumentSun {
public:
    DocumentSun() : m_face(*this) {}
    DocumentSun(const DocumentSun&) = delete;
    DocumentSun& operator=(const DocumentSun&) = delete;

    bool isEnabled() const { return m_state.enabled; }
    const KM_3dVector& directionToSun() const { return m_state.direction_to_sun; }
    /// Whether it stands elsewhere than a new one.
    bool wasMoved() const { return m_state.direction_to_sun != State().direction_to_sun; }

    /// Opens a change; changes nest, and each must be ended.
    void beginChange();
    /// Turns the sun on or off; without an open change nothing happens.
    void setEnabled(bool enabled);
    /// Moves the sun; without an open change, or for a vector of no length, nothing happens.
    /// @param direction_to_sun  of any length, from the model toward the sun
    void setDirectionToSun(const KM_3dVector& direction_to_sun);
    /// Closes the change that was opened last.
    /// @return true when the sun is another than when it was opened; false without an open change
    bool endChange();

    /// Sets both as they were stored, to the last bit.
    /// @param direction_to_sun  a unit vector
    void restore(bool enabled, const KM_3dVector& direction_to_sun) {
        m_state = {enabled, direction_to_sun};
    }

    /// The place and time that the sun was put by last, to be offered again; nothing when none was
    /// given since the document was opened. Files do not hold it, and the sun may be elsewhere.
    const std::optional<PlaceAndTime>& lastPlaceAndTime() const { return m_last_place_and_time; }
    void setLastPlaceAndTime(const PlaceAndTime& last) { m_last_place_and_time = last; }

    /// The light that the sun sheds; nothing while it is off.
    std::optional<KM_Light> light() const;

    /// From now on every call of a plug-in is a breach.
    void close() { m_is_open = false; }
    bool isOpen() const { return m_is_open; }

    /// What plug-ins see of the sun.
    CQuarnSun& face() { return m_face; }

private:
    struct State {
        bool enabled = true;
        KM_3dVector direction_to_sun{0.5, -0.5, 0.70710678118654752};
        friend bool operator==(const State&, const State&) = default;
    };

    State m_state;
    std::vector<State> m_at_change_begin; ///< one for each open change
    std::optional<PlaceAndTime> m_last_place_and_time;
    CQuarnSun m_face;
    bool m_is_open = true;
};

} // namespace quarn
