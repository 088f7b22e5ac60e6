#include "zoetrix/sun/VyrSun.h"

#include <cmath>

namespace {

constexpr double pi = 3.141592653589793;

constexpr double first_julian_day = 2378496.5;
constexpr double last_julian_day = 2524593.499999999;

double RadiansFrom(double degrees) {
    return degrees * pi / 180.0;
}

double DegreesFrom(double radians) {
    return radians / pi * 180.0;
}

/// Brings an angle in degrees into 0 up to 360.
double Wrap(double degrees) {
    const double turns = degrees / 360.0;
    const double wrapped = (turns - std::trunc(turns)) * 360.0;
    return wrapped < 0.0 ? wrapped + 360.0 : wrapped;
}

/// False also for what is not a number.
template <class Number> bool IsWithin(Number value, Number first, Number last) {
    return value >= first && value <= last;
}

/// The time since noon of 1 January 2000.
struct Epoch {
    explicit Epoch(double julian_day)
        : days(julian_day - 2451545.0), T(days / 36525.0), T2(T * T), T3(T * T2) {}

    double days;
    double T; ///< Julian centuries
    double T2;
    double T3;
};

/// Radians. The longitude of the ascending node of the Moon's mean orbit.
double AscendingNode(const Epoch& epoch) {
    return RadiansFrom(125.04 - 1934.136 * epoch.T);
}

double MeanLongitude(const Epoch& epoch) {
    return 280.46646 + 36000.76983 * epoch.T + 0.0003032 * epoch.T2;
}

double EquationOfCentre(const Epoch& epoch) {
    const double T = epoch.T;
    const double M = RadiansFrom(357.52911 + 35999.05029 * T - 0.0001537 * epoch.T2);
    return (1.914602 - 0.004817 * T - 0.000014 * epoch.T2) * std::sin(M) +
           (0.019993 - 0.000101 * T) * std::sin(2.0 * M) + 0.000289 * std::sin(3.0 * M);
}

/// The published series has + 0.00059 T2 - 0.001813 T3. The two signs are
/// turned here, which moves the obliquity by less than 0.00001 degrees in the years 1800 to 2200.
double Obliquity(const Epoch& epoch, double ascending_node) {
    return 23.439291111 - (46.815 * epoch.T - 0.00059 * epoch.T2 + 0.001813 * epoch.T3) / 3600.0 +
           0.00256 * std::cos(ascending_node);
}

double SiderealTimeAtGreenwich(const Epoch& epoch) {
    return Wrap(280.46061837 + 360.98564736629 * epoch.days + 0.000387933 * epoch.T2 -
                epoch.T3 / 38710000.0);
}

struct EquatorialCoordinates {
    double right_ascension; ///< degrees, 0 up to 360
    double declination;     ///< radians
};

/// @param longitude  the sun's longitude on the ecliptic in degrees, not yet corrected for
///                   aberration and nutation
EquatorialCoordinates ApparentPlace(const Epoch& epoch, double longitude) {
    const double node = AscendingNode(epoch);
    const double lambda = RadiansFrom(longitude - 0.00569 - 0.00478 * std::sin(node));
    const double epsilon = RadiansFrom(Obliquity(epoch, node));
    const double sin_lambda = std::sin(lambda);
    const double y = std::cos(epsilon) * sin_lambda;
    return {Wrap(DegreesFrom(std::atan2(y, std::cos(lambda)))),
            std::asin(std::sin(epsilon) * sin_lambda)};
}

} // namespace

CVyrSun::CVyrSun() = default;
CVyrSun::~CVyrSun() = default;

void CVyrSun::Changed() {}

bool CVyrSun::SetLatitude(double latitude) {
    if (!IsWithin(latitude, -90.0, 90.0))
        return false;
    if (latitude == m_latitude)
        return true;
    m_latitude = latitude;
    m_sin_latitude = std::sin(RadiansFrom(latitude));
    m_cos_latitude = std::cos(RadiansFrom(latitude));
    m_modified = true;
    Changed();
    return true;
}

bool CVyrSun::SetLongitude(double longitude) {
    if (!IsWithin(longitude, -180.0, 180.0))
        return false;
    if (longitude == m_longitude)
        return true;
    m_longitude = longitude;
    m_modified = true;
    Changed();
    return true;
}

bool CVyrSun::SetTimeZoneHours(double hours) {
    if (!IsWithin(hours, -12.0, 13.0))
        return false;
    if (hours == m_time_zone_hours)
        return true;
    m_time_zone_hours = hours;
    m_modified = true;
    m_fast_modified = true;
    Changed();
    return true;
}

bool CVyrSun::SetDaylightSavingMinutes(int minutes) {
    if (!IsWithin(minutes, 0, 120))
        return false;
    if (minutes == m_daylight_saving_minutes)
        return true;
    m_daylight_saving_minutes = minutes;
    m_modified = true;
    m_fast_modified = true;
    Changed();
    return true;
}

bool CVyrSun::SetLocalDateTime(int year, int month, int day, double hours) {
    if (!IsWithin(year, 1800, 2199) || !IsWithin(month, 1, 12))
        return false;
    if (!IsWithin(day, 1, DaysInMonth(month, year)) || !IsWithin(hours, 0.0, 24.0))
        return false;
    // January and February count as the months 13 and 14 of the year before.
    const int y = month < 3 ? year - 1 : year;
    const int m = month < 3 ? month + 12 : month;
    const int a = y / 100;
    const int b = y / 400;
    const int noon = day - a + b + (306 * (m + 1)) / 10 + (36525 * y + 172'251'900) / 100 - 1522;
    return SetLocalJulianDay(noon + hours / 24.0 - 0.5);
}

bool CVyrSun::SetLocalJulianDay(double julian_day) {
    if (!IsWithin(julian_day, first_julian_day, last_julian_day))
        return false;
    if (julian_day == m_local_julian_day)
        return true;
    m_local_julian_day = julian_day;
    m_modified = true;
    m_fast_modified = true;
    Changed();
    return true;
}

void CVyrSun::LocalDateTime(int& year, int& month, int& day, double& hours) const {
    const double s = m_local_julian_day + 0.5;
    const int Z = static_cast<int>(s);
    const double F = s - Z;
    const int since_gregory = 100 * Z - 186'721'625;
    const int alpha = since_gregory / 3'652'425;
    const int B = Z + alpha - since_gregory / 14'609'700 + 1525;
    const int G = (100 * B - 12'210) / 36525;
    const int D = B - 365 * G - (100 * B - 12'210) / 146'100;
    const int E = 10'000 * D / 306'001;
    day = D - 306'001 * E / 10'000;
    month = 10'000 * D < 4'284'014 ? E - 1 : E - 13;
    year = month > 2 ? G - 4716 : G - 4715;
    hours = F * 24.0 + 1e-8;
}

double CVyrSun::LocalJulianDay() const {
    return m_local_julian_day;
}

double CVyrSun::TimeZoneHours() const {
    return m_time_zone_hours;
}

int CVyrSun::DaylightSavingMinutes() const {
    return m_daylight_saving_minutes;
}

double CVyrSun::JulianDay() const {
    return m_local_julian_day - (m_time_zone_hours + m_daylight_saving_minutes / 60.0) / 24.0;
}

double CVyrSun::Azimuth() const {
    UpdateIfModified();
    return m_azimuth;
}

double CVyrSun::Altitude() const {
    UpdateIfModified();
    return m_altitude;
}

void CVyrSun::UpdateIfModified() const {
    if (!m_modified)
        return;
    const Epoch epoch(JulianDay());
    const double true_longitude = Wrap(MeanLongitude(epoch) + EquationOfCentre(epoch));
    const auto [alpha, delta] = ApparentPlace(epoch, true_longitude);
    const double H = RadiansFrom(SiderealTimeAtGreenwich(epoch) + m_longitude - alpha);
    const double phi = RadiansFrom(m_latitude);
    const double sin_phi = std::sin(phi);
    const double cos_phi = std::cos(phi);
    const double cos_H = std::cos(H);
    const double from_south = std::atan2(std::sin(H), sin_phi * cos_H - std::tan(delta) * cos_phi);
    m_azimuth = Wrap(DegreesFrom(from_south) + 180.0);
    m_altitude =
        DegreesFrom(std::asin(sin_phi * std::sin(delta) + cos_phi * std::cos(delta) * cos_H));
    m_modified = false;
}

void CVyrSun::UpdateFastCache() const {
    const Epoch epoch(JulianDay());
    const auto [alpha, radians] = ApparentPlace(epoch, Wrap(MeanLongitude(epoch)));
    // By way of degrees, which decides on the last digit.
    const double delta = RadiansFrom(DegreesFrom(radians));
    m_fast_right_ascension = alpha;
    m_fast_sin_declination = std::sin(delta);
    m_fast_cos_declination = std::cos(delta);
    m_fast_sidereal_time = SiderealTimeAtGreenwich(epoch);
    m_fast_modified = false;
}

double CVyrSun::FastAltitude() const {
    if (m_fast_modified)
        UpdateFastCache();
    const double H = RadiansFrom(m_fast_sidereal_time + m_longitude - m_fast_right_ascension);
    return DegreesFrom(std::asin(m_sin_latitude * m_fast_sin_declination +
                                 m_cos_latitude * m_fast_cos_declination * std::cos(H)));
}

int CVyrSun::DaysInMonth(int month, int year) {
    constexpr int days[] = {0, 31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    const bool is_leap_year = year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
    return month == 2 && is_leap_year ? 29 : days[month];
}

void CVyrSun::ConvertHorizonCoordsToSolarVector(double azimuth, double altitude, double* vec) {
    const double A = RadiansFrom(azimuth);
    const double h = RadiansFrom(altitude);
    vec[0] = -(std::cos(h) * std::sin(A));
    vec[1] = -(std::cos(h) * std::cos(A));
    vec[2] = -std::sin(h);
}

void CVyrSun::ConvertSolarVectorToHorizonCoords(const double* vec, double& azimuth,
                                                double& altitude) {
    const double h = std::asin(-vec[2]);
    const double c = std::cos(h);
    const double A = DegreesFrom(std::atan2(vec[0] / -c, vec[1] / -c));
    azimuth = A < 0.0 ? A + 360.0 : A;
    altitude = DegreesFrom(h);
}
