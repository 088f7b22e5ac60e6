#pragma once

/// Azimuth and altitude of the sun for a place and a local time, without anything else of this
/// system.
///
/// Source of the formulas: J. Meeus, Astronomical Algorithms (2nd edition): the Julian day of
/// chapter 7, sidereal time (12.4), horizontal coordinates (13.5, 13.6), mean obliquity (22.2) and
/// the low-accuracy place of the sun of chapter 25, good to 0.01 degrees. It departs from them in
/// three things, on which results depend: in the obliquity the terms of T squared and T cubed have
/// the opposite sign (below 0.00001 degrees from 1800 to 2199); dynamical time is taken to be
/// universal time; and the azimuth counts from north, not from south. There is no correction for
/// refraction or parallax.
///
/// All angles are degrees. Results are computed when they are asked for and kept by const
/// operations, so that one object must not be used by two threads at once.
///
/// The setters return false, and change nothing, for a value out of range or not a number. They
/// return true for any other; where it differs from the present one they also call Changed().
class CVyrSun {
public:
    /// Latitude and longitude 0, local Julian day 0, universal time, no daylight saving.
    CVyrSun();
    virtual ~CVyrSun();

    /// Called after every change of an input, with the new value in place. Does nothing here; it is
    /// there for derived classes.
    virtual void Changed();

    /// @param latitude  degrees, north positive, -90 to 90
    bool SetLatitude(double latitude);
    /// @param longitude  degrees, east positive, -180 to 180
    bool SetLongitude(double longitude);
    /// @param hours  what local standard time is ahead of universal time, -12 to 13
    bool SetTimeZoneHours(double hours);
    /// @param minutes  what the clock is ahead of local standard time, 0 to 120
    bool SetDaylightSavingMinutes(int minutes);
    /// Sets the local Julian day from a Gregorian date and the time that the clock shows.
    ///
    /// @param year   1800 to 2199
    /// @param month  1 to 12
    /// @param day    1 to the days of the month
    /// @param hours  0 to 24; 24 is the midnight that begins the next day, and out of range on
    ///               31 December 2199
    bool SetLocalDateTime(int year, int month, int day, double hours);
    /// @param julian_day  Julian day of the local date and time, 2378496.5 (the beginning of 1800)
    ///                    to 2524593.499999999 (the end of 2199)
    bool SetLocalJulianDay(double julian_day);

    /// Gives the local date and time as a Gregorian date and hours.
    ///
    /// @param hours  from 0; 1e-8 more than the stored time, so that a whole hour never reads as a
    ///               hair less. Like the stored Julian day it is good to some 0.00005 seconds
    void LocalDateTime(int& year, int& month, int& day, double& hours) const;

    double LocalJulianDay() const;
    double TimeZoneHours() const;
    int DaylightSavingMinutes() const;
    /// The Julian day in universal time: the local one less time zone and daylight saving.
    double JulianDay() const;

    /// @return degrees clockwise from north, 0 up to 360
    double Azimuth() const;
    /// @return degrees above the horizon, negative at night
    double Altitude() const;
    /// Computes azimuth and altitude anew if an input has changed since they were computed.
    void UpdateIfModified() const;

    /// The altitude with the mean longitude of the sun in the place of the true one, so that the
    /// sun stands up to 2 degrees of longitude from where it is. What depends on the date alone is
    /// kept while latitude and longitude change.
    ///
    /// @return degrees above the horizon
    double FastAltitude() const;

    /// @param month  1 to 12; it is not checked
    /// @param year   of the Gregorian calendar
    static int DaysInMonth(int month, int year);

    /// Gives the direction of the sunlight: the unit vector from the sun to the observer.
    ///
    /// @param azimuth   degrees clockwise from north
    /// @param altitude  degrees above the horizon
    /// @param vec       gets three components (x east, y north, z up)
    static void ConvertHorizonCoordsToSolarVector(double azimuth, double altitude, double* vec);
    /// The inverse of ConvertHorizonCoordsToSolarVector for altitudes between -90 and 90, both
    /// excluded.
    ///
    /// @param vec       three components of a unit vector
    /// @param azimuth   gets degrees clockwise from north, 0 up to 360
    /// @param altitude  gets degrees above the horizon
    static void ConvertSolarVectorToHorizonCoords(const double* vec, double& azimuth,
                                                  double& altitude);

protected:
    /// Whether the next call of Azimuth or Altitude computes.
    bool IsModified() const { return m_modified; }
    /// Whether the next call of FastAltitude computes what depends on the date.
    bool IsFastModified() const { return m_fast_modified; }

private:
    void UpdateFastCache() const;

    double m_latitude = 0.0;
    double m_longitude = 0.0;
    double m_local_julian_day = 0.0;
    double m_time_zone_hours = 0.0;
    int m_daylight_saving_minutes = 0;

    mutable double m_azimuth = 0.0;
    mutable double m_altitude = 0.0;
    mutable bool m_modified = true;

    // What the fast altitude keeps of the date; worthless while m_fast_modified is set.
    mutable double m_fast_right_ascension = 0.0;
    mutable double m_fast_sin_declination = 0.0;
    mutable double m_fast_cos_declination = 0.0;
    mutable double m_fast_sidereal_time = 0.0;
    mutable bool m_fast_modified = true;

    double m_sin_latitude = 0.0;
    double m_cos_latitude = 1.0;
};
