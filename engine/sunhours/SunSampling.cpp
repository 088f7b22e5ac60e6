#include "engine/sunhours/SunSampling.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/FlushDenormals.h"
#include "engine/sunhours/GlassFilter.h"
#include "engine/sunhours/SunPackets.h"

#include <tbb/parallel_for.h>

#include <chrono>

namespace quarn {

namespace {

/// Of a task: they fit into a core's own memory, and each of the sun's directions goes through all
/// of them.
constexpr std::size_t PACKETS_AT_ONCE = 64;
constexpr double BATCH_SECONDS = 0.1;

std::vector<SunRayStep> stepsByDay(std::span<const SunStep> steps) {
    std::vector<SunRayStep> by_day;
    for (std::size_t i = 0; i < steps.size(); ++i) {
        const KM_3dVector& toward = steps[i].toward;
        if (toward.z > 0.0)
            by_day.push_back({{static_cast<float>(toward.x), static_cast<float>(toward.y),
                               static_cast<float>(toward.z)},
                              static_cast<float>(steps[i].hours),
                              i});
    }
    return by_day;
}

/// Goes through tasks, as many at a time as last for about a tenth of a second.
template <class Task> bool runWatched(std::size_t tasks, const SunWatch& watch, const Task& task) {
    std::size_t batch = 4;
    for (std::size_t done = 0; done < tasks;) {
        if (!watch(static_cast<double>(done) / static_cast<double>(tasks)))
            return false;
        const std::size_t next = std::min(tasks, done + batch);
        const auto start = std::chrono::steady_clock::now();
        tbb::parallel_for(done, next, task);
        const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - start;
        done = next;
        if (taken.count() < 0.5 * BATCH_SECONDS)
            batch = std::min(2 * batch, tasks);
        else if (taken.count() > 2.0 * BATCH_SECONDS && batch > 4)
            batch /= 2;
    }
    return watch(1.0);
}

} // namespace

bool findSun(const DisplayScene& scene, const SurfacePoints& points, std::span<const SunStep> steps,
             bool notes_steps, const SunWatch& watch, SunLight& light) {
    const std::vector<PointPacket>& packets = points.packets();
    const std::vector<SunRayStep> by_day = stepsByDay(steps);
    light.packets = packets.size();
    light.hours.assign(packets.size() * points_at_once, 0.0F);
    light.lit.assign(notes_steps ? steps.size() * packets.size() : 0, 0);
    const PacketLight noted{light.hours.data(), notes_steps ? light.lit.data() : nullptr,
                            packets.size()};
    const RTCScene root = scene.rays().root();
    const std::size_t tasks = (packets.size() + PACKETS_AT_ONCE - 1) / PACKETS_AT_ONCE;
    const bool is_done = runWatched(tasks, watch, [&](std::size_t task) {
        const FlushDenormals flush;
        GlassFilter filter(scene, false);
        const std::size_t begin = task * PACKETS_AT_ONCE;
        lightPackets(packets, begin, std::min(packets.size(), begin + PACKETS_AT_ONCE), by_day,
                     noted, [&](const int* valid, RTCRay16& rays) {
                         // Not coherent: occlusion packets of partly masked rays do not end there
                         // in Embree 3.13.
                         if (root)
                             rtcOccluded16(valid, root, &filter.context, &rays);
                     });
    });
    light.hours.resize(points.size());
    return is_done;
}

} // namespace quarn
