#pragma once

#include "sdk/qncore/QnExport.h"

/// The sun of the rendering kit: where the sun stands in the sky of a place at a local time.
///
/// A new sun stands for latitude 0, longitude 0, time zone 0 and 1 January 2000 at 12 o'clock. The
/// place and the time may be set in any order and any number of times; each reading answers for
/// what is set at that moment. Different objects may be used on different threads at the same
/// time; one object belongs to one thread, for it remembers what it has computed.
///
/// Positions are apparent and topocentric: of the sun's centre, as seen from sea level, without
/// refraction by the air (which would lift a sun at the horizon by about 0.57 degrees). Clocks are
/// taken to show universal time UT1 plus the zone; civil clocks keep within 0.9 seconds of that,
/// during which the sun turns by at most 0.004 degrees.
///
/// There is no position, both readings are not a number, and the host tells once in a command why,
/// unless all of these hold:
///   - latitude from -90 to 90, longitude from -360 to 360
///   - time zone from -24 to 24
///   - the date is one of the Gregorian calendar (there is no 31 April), of the years 1800 to 2199
///   - hours from 0 to 24
class QNCORE_API CQnZelSun {
public:
    /// @param degrees  geodetic, north positive
    void SetLatitude(double degrees);
    /// @param degrees  east positive; a whole turn more or less is the same place
    void SetLongitude(double degrees);
    /// @param hours  what local clocks are ahead of universal time
    void SetTimeZone(int hours);
    /// @param year   of the Gregorian calendar
    /// @param month  from 1
    /// @param day    of the month, from 1
    /// @param hours  since local midnight, with their fraction: 14.5 is half past two
    void SetLocalDateTime(int year, int month, int day, double hours);

    /// @return degrees clockwise from north as seen from above, from 0 up to but not including 360.
    ///         At a pole, north is the direction in which the meridian of the longitude goes on.
    ///         Not a number when there is no position
    double Azimuth() const;
    /// @return degrees above the horizon, from -90 to 90, negative while the sun is down; not a
    ///         number when there is no position
    double Altitude() const;

private:
    /// Computes the position unless it is known from an earlier reading.
    void Find() const;

    double m_latitude_deg = 0;
    double m_longitude_deg = 0;
    int m_zone_hours = 0;
    int m_year = 2000;
    int m_month = 1;
    int m_day = 1;
    double m_hours = 12;

    mutable bool m_is_found = false;
    mutable double m_azimuth_deg = 0;
    mutable double m_altitude_deg = 0;
};
