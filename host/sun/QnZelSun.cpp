#include "sdk/zel/QnZelSun.h"

#include "host/sun/CalendarDay.h"
#include "host/sun/MissingSun.h"
#include "host/sun/SunPosition.h"
#include "host/sun/SunYears.h"

#include <cmath>
#include <limits>

namespace {

constexpr double NOT_A_NUMBER = std::numeric_limits<double>::quiet_NaN();

/// Julian day number of the midnight that began 1 January 1970.
constexpr double EPOCH_JULIAN_DAY = 2440587.5;

/// Also refuses what is not a number.
bool isWithin(double value, double limit) {
    return std::abs(value) <= limit;
}

} // namespace

void CQnZelSun::SetLatitude(double degrees) {
    m_latitude_deg = degrees;
    m_is_found = false;
}

void CQnZelSun::SetLongitude(double degrees) {
    m_longitude_deg = degrees;
    m_is_found = false;
}

void CQnZelSun::SetTimeZone(int hours) {
    m_zone_hours = hours;
    m_is_found = false;
}

void CQnZelSun::SetLocalDateTime(int year, int month, int day, double hours) {
    m_year = year;
    m_month = month;
    m_day = day;
    m_hours = hours;
    m_is_found = false;
}

double CQnZelSun::Azimuth() const {
    Find();
    return m_azimuth_deg;
}

double CQnZelSun::Altitude() const {
    Find();
    return m_altitude_deg;
}

void CQnZelSun::Find() const {
    if (m_is_found)
        return;
    m_is_found = true;
    m_azimuth_deg = NOT_A_NUMBER;
    m_altitude_deg = NOT_A_NUMBER;
    const auto day = quarn::calendarDay(m_year, m_month, m_day);
    const bool is_place = isWithin(m_latitude_deg, 90) && isWithin(m_longitude_deg, 360);
    const bool is_time = isWithin(m_zone_hours, 24) && isWithin(m_hours - 12, 12);
    if (!day || !quarn::isSunYear(m_year) || !is_place || !is_time) {
        quarn::noteMissingSun({m_year, m_month, m_day, m_latitude_deg, m_longitude_deg});
        return;
    }

    const double julian_day = EPOCH_JULIAN_DAY + day->time_since_epoch().count();
    const double fraction = (m_hours - m_zone_hours) / 24;
    const quarn::SunPosition position =
        quarn::sunPosition({m_latitude_deg, m_longitude_deg}, julian_day, fraction);
    m_azimuth_deg = position.azimuth_deg;
    m_altitude_deg = position.altitude_deg;
}
