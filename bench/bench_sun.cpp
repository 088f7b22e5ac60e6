// The fast altitude of the sun beside the precise one, over places all around the earth at one
// moment, as a map of day and night asks for them. Both include setting the place. They take turns,
// and the best of many rounds counts. Then the sun points of a week in 10 thousand frames.

#include "zoetrix/plugin/ZoetrixUtilities.h"
#include "zoetrix/sun/VyrSun.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>

namespace {

using Clock = std::chrono::steady_clock;

constexpr int places = 200'000;
constexpr int rounds = 15;
constexpr int frames = 10'000;

struct Pass {
    double ns_a_place = std::numeric_limits<double>::infinity();
    double sum = 0.0; ///< of the altitudes; both ways must nearly agree
};

template <class Altitude> void measure(CVyrSun& sun, Pass& best, Altitude altitude) {
    double sum = 0.0;
    const Clock::time_point start = Clock::now();
    for (int i = 0; i < places; ++i) {
        sun.SetLatitude(-89.0 + 178.0 * i / places);
        sun.SetLongitude(-180.0 + 360.0 * (i % 1009) / 1009);
        sum += altitude(sun);
    }
    const std::chrono::duration<double, std::nano> spent = Clock::now() - start;
    best.ns_a_place = std::min(best.ns_a_place, spent.count() / places);
    best.sum = sum;
}

/// @return microseconds a frame; infinite when a frame has no sun
double sunPoints() {
    const Clock::time_point start = Clock::now();
    for (int i = 0; i < frames; ++i) {
        const int minute = i % 1440;
        const int day = 1 + i / 1440;
        if (!CZoetrixUtilities::GetSunPoint(minute / 60, minute % 60, 2026, 6, day, 0.0, 51.5,
                                            -0.12)
                 .IsValid())
            return std::numeric_limits<double>::infinity();
    }
    const std::chrono::duration<double, std::micro> spent = Clock::now() - start;
    return spent.count() / frames;
}

} // namespace

int main() {
    CVyrSun sun;
    if (!sun.SetLocalDateTime(2026, 6, 21, 12.0))
        return EXIT_FAILURE;
    Pass precise;
    Pass fast;
    for (int round = 0; round < rounds; ++round) {
        measure(sun, precise, [](const CVyrSun& at) { return at.Altitude(); });
        measure(sun, fast, [](const CVyrSun& at) { return at.FastAltitude(); });
    }
    const double ratio = precise.ns_a_place / fast.ns_a_place;
    std::printf("precise altitude %.0f ns   fast altitude %.0f ns   ratio %.2f\n",
                precise.ns_a_place, fast.ns_a_place, ratio);
    const double point_us = sunPoints();
    std::printf("sun point %.2f us a frame, %d frames in %.3f s\n", point_us, frames,
                1e-6 * point_us * frames);
    // The mean longitude misses the true one by less than 2 degrees, and so do the altitudes.
    const bool agree = std::abs(precise.sum - fast.sum) < 2.0 * places;
    return agree && std::isfinite(point_us) ? EXIT_SUCCESS : EXIT_FAILURE;
}
