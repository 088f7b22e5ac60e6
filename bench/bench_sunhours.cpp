// Hours of sun on a landscape of a million triangles: a day in steps of 10 minutes, and how much of
// the time is spent in the ray tracer's own queries; with "year", every seventh day of a year in
// steps of 15 minutes.
//
// usage: bench_sunhours [year]

#include "bench/Hills.h"
#include "bench/Timing.h"
#include "engine/display/DisplayScene.h"
#include "engine/sunhours/PicturePoints.h"
#include "engine/sunhours/SunPackets.h"
#include "engine/sunhours/SunSampling.h"
#include "host/sun/SunDirection.h"

#include <algorithm>
#include <cstring>
#include <ctime>

namespace {

constexpr int WIDTH = 1280;
constexpr int HEIGHT = 720;
constexpr double JULIAN_DAY_OF_2026_03_21 = 2461120.5;
constexpr quarn::SunSite ATHENS{37.98, 23.73};

std::vector<quarn::SunStep> stepsOf(int days, int days_apart, int minutes) {
    std::vector<quarn::SunStep> steps;
    for (int day = 0; day < days; day += days_apart)
        for (int minute = 0; minute < 1440; minute += minutes) {
            const quarn::SunPosition sun =
                quarn::sunPosition(ATHENS, JULIAN_DAY_OF_2026_03_21 + day, minute / 1440.0);
            steps.push_back({quarn::directionToSun(sun), minutes / 60.0});
        }
    return steps;
}

/// What is left of the work where the ray tracer does nothing.
double millisecondsWithoutQueries(const quarn::SurfacePoints& points,
                                  std::span<const quarn::SunStep> steps) {
    std::vector<quarn::SunRayStep> rays;
    for (const quarn::SunStep& step : steps)
        if (step.toward.z > 0.0)
            rays.push_back({{static_cast<float>(step.toward.x), static_cast<float>(step.toward.y),
                             static_cast<float>(step.toward.z)},
                            static_cast<float>(step.hours),
                            rays.size()});
    std::vector<float> hours(points.packets().size() * quarn::points_at_once);
    const auto start = bench::Clock::now();
    constexpr std::size_t AT_ONCE = 64;
    for (std::size_t begin = 0; begin < points.packets().size(); begin += AT_ONCE)
        quarn::lightPackets(points.packets(), begin,
                            std::min(points.packets().size(), begin + AT_ONCE), rays,
                            {hours.data(), nullptr, 0}, [](const int*, RTCRay16&) {});
    return bench::millisecondsSince(start);
}

std::size_t daySteps(std::span<const quarn::SunStep> steps) {
    return static_cast<std::size_t>(
        std::ranges::count_if(steps, [](const auto& step) { return step.toward.z > 0.0; }));
}

} // namespace

int main(int count, char** words) {
    const bool is_year = count > 1 && std::strcmp(words[1], "year") == 0;
    const auto mesh = bench::makeHills(708);
    quarn::DisplayScene scene;
    bench::require(scene.update(bench::sunlit(mesh)));
    const std::vector<quarn::SunStep> steps = is_year ? stepsOf(365, 7, 15) : stepsOf(1, 1, 10);

    auto start = bench::Clock::now();
    const auto seen = quarn::pointsSeen(scene, bench::hillsView(), WIDTH, HEIGHT,
                                        quarn::PixelTiles(WIDTH, HEIGHT).places());
    const double seen_ms = bench::millisecondsSince(start);
    std::printf("%s triangles, %dx%d, %zu steps by day\nsurfaces seen %8.2f s\n",
                bench::inWords(mesh->TriangleCount()).c_str(), WIDTH, HEIGHT, daySteps(steps),
                seen_ms / 1000.0);

    quarn::SunLight light;
    start = bench::Clock::now();
    const std::clock_t processor_start = std::clock();
    quarn::findSun(
        scene, seen.points, steps, false, [](double) { return true; }, light);
    const double ms = bench::millisecondsSince(start);
    const double processor_s = double(std::clock() - processor_start) / CLOCKS_PER_SEC;
    double sum = 0.0;
    for (const float hours : light.hours)
        sum += hours;
    const double other_s = millisecondsWithoutQueries(seen.points, steps) / 1000.0;
    std::printf("sun           %8.2f s (%.2f s of processors), mean %.3f h\n", ms / 1000.0,
                processor_s, sum / double(light.hours.size()));
    std::printf("in queries    %8.1f %% of that\n", 100.0 * (1.0 - other_s / processor_s));
    return 0;
}
