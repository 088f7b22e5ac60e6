#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cmath>

namespace {

constexpr double pi = 3.141592653589793;
constexpr double radians_per_day = 0.01721420632103996; // of a year of 365 days
constexpr double radians_per_degree = 0.017453292519943295;

/// Minutes that a sundial is ahead of mean solar time.
double EquationOfTime(double g) {
    return 229.18 * (0.000075 + 0.001868 * std::cos(g) - 0.032077 * std::sin(g) -
                     0.014615 * std::cos(2.0 * g) - 0.040849 * std::sin(2.0 * g));
}

} // namespace

double CZoetrixUtilities::Gamma(int day, int hour) {
    return radians_per_day * (day - 1 + (hour - 12) / 24);
}

double CZoetrixUtilities::Declination(int day, int hour) {
    const double g = Gamma(day, hour);
    return 0.006918 - 0.39912 * std::cos(g) + 0.070257 * std::sin(g) -
           0.006758 * std::cos(2.0 * g) + 0.000907 * std::sin(2.0 * g) -
           0.002697 * std::cos(3.0 * g) + 0.00148 * std::sin(3.0 * g);
}

double CZoetrixUtilities::Arccos(double x) {
    return std::atan(-x / std::sqrt(1.0 - x * x)) + pi / 2.0;
}

double CZoetrixUtilities::HourAngle(int day, int hour, int minute, int second, double longitude,
                                    double timeZone) {
    const double eqt = EquationOfTime(Gamma(day, hour));
    const int clock_minutes = hour * 60 + minute + second / 60;
    const double true_solar_time = clock_minutes + eqt - 4.0 * longitude + 60.0 * timeZone;
    return (true_solar_time / 4.0 - 180.0) * radians_per_degree;
}

double CZoetrixUtilities::Zenith(int day, int hour, int minute, int second, double longitude,
                                 double latitude, double timeZone) {
    const double delta = Declination(day, hour);
    const double h = HourAngle(day, hour, minute, second, longitude, timeZone);
    const double phi = latitude * pi / 180.0;
    return Arccos(std::sin(phi) * std::sin(delta) + std::cos(phi) * std::cos(delta) * std::cos(h));
}

double CZoetrixUtilities::Azimuth(int day, int hour, int minute, int second, double longitude,
                                  double latitude, double timeZone) {
    const double delta = Declination(day, hour);
    const double phi = latitude * pi / 180.0;
    const double z = Zenith(day, hour, minute, second, longitude, latitude, timeZone);
    const double a =
        Arccos((std::cos(z) * std::sin(phi) - std::sin(delta)) / (std::sin(z) * std::cos(phi)));
    const bool is_after_noon = hour * 60 + minute > 720;
    return (is_after_noon ? -a : a) + pi;
}
