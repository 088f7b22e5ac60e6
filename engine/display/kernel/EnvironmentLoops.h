#pragma once

#include "engine/display/kernel/OpenSky.h"
#include "engine/display/kernel/SurroundingLight.h"

namespace quarn {
namespace {

/// The directions of some texels of a row, of unit length. Those of the border lie across the edge.
inline LaneVectors directionsOfTexels(const Lanes& column, int row) {
    constexpr float scale = 2.0F / environment_map::side;
    Lanes u = (column - 0.5F) * scale - 1.0F;
    Lanes v = (Lanes(static_cast<float>(row)) - 0.5F) * scale - 1.0F;
    const LaneMask beside = magnitude(u) > 1.0F;
    u = select(beside, withSignOf(Lanes(2.0F) - magnitude(u), u), u);
    v = select(beside, -v, v);
    const LaneMask above = magnitude(v) > 1.0F;
    v = select(above, withSignOf(Lanes(2.0F) - magnitude(v), v), v);
    u = select(above, -u, u);
    const Lanes z = Lanes(1.0F) - magnitude(u) - magnitude(v);
    const LaneVectors folded{withSignOf(magnitude(Lanes(1.0F) - magnitude(v)), u),
                             withSignOf(magnitude(Lanes(1.0F) - magnitude(u)), v), z};
    return ofUnitLength(select(z < 0.0F, folded, LaneVectors{u, v, z}));
}

/// The light of texels of a level, from that of the level before.
inline LaneColors blurredLight(const FrameSetup& frame, const EnvironmentSamples& samples,
                               int level, const LaneVectors& normal) {
    const LaneFrame around = frameAround(normal);
    LaneColors sum{0.0F, 0.0F, 0.0F};
    for (int i = 0; i < environment_map::samples; ++i) {
        const float weight = samples.weight[i];
        if (weight <= 0.0F)
            continue;
        const auto axis = [&](const Lanes& a, const Lanes& b, const Lanes& n) {
            return a * samples.x[i] + b * samples.y[i] + n * samples.z[i];
        };
        const LaneVectors direction{axis(around.a.x, around.b.x, normal.x),
                                    axis(around.a.y, around.b.y, normal.y),
                                    axis(around.a.z, around.b.z, normal.z)};
        const LaneColors light = level == 1
                                     ? broadLight(frame, direction)
                                     : pictureAt(frame, LaneInts(level - 1),
                                                 placeOnMap<environment_map::side>(direction));
        sum = {sum.r + light.r * weight, sum.g + light.g * weight, sum.b + light.b * weight};
    }
    return sum;
}

void findLightAround(const FrameSetup& frame, const float (&directions)[3][lane_count],
                     float (&colors)[3][lane_count]) {
    const LaneColors light =
        broadLight(frame, {load(directions[0]), load(directions[1]), load(directions[2])});
    store(colors[0], light.r);
    store(colors[1], light.g);
    store(colors[2], light.b);
}

void findEnvironment(const FrameSetup& frame, const EnvironmentSamples& samples, int level,
                     int row) {
    constexpr int stride = environment_map::stride;
    constexpr int texels = environment_map::texels;
    float* const to = frame.environment + (level - 1) * environment_map::channels * texels;
    for (int first = 0; first < stride; first += lane_count) {
        const LaneVectors normal =
            directionsOfTexels(floatsOf(laneNumbers()) + static_cast<float>(first), row);
        const LaneColors light = blurredLight(frame, samples, level, normal);
        alignas(64) float colors[environment_map::channels][lane_count];
        store(colors[0], light.r);
        store(colors[1], light.g);
        store(colors[2], light.b);
        const int count = stride - first < lane_count ? stride - first : lane_count;
        for (int c = 0; c < environment_map::channels; ++c)
            __builtin_memcpy(to + c * texels + row * stride + first, colors[c],
                             static_cast<std::size_t>(count) * sizeof(float));
    }
}

} // namespace
} // namespace quarn
