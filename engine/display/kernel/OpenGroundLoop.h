#pragma once

#include "engine/display/kernel/OpenSky.h"

namespace quarn {
namespace {

/// Looks from places on the ground in one direction.
/// @return the part of the light from there that arrives
inline Lanes arrivingOnGround(const FrameSetup& frame, const LaneVectors& place,
                              const float (&toward)[3]) {
    const LaneVectors direction{toward[0], toward[1], toward[2]};
    const LaneMask look = reachesScene(frame, place, direction, unlimited);
    if (!any(look))
        return 1.0F;
    RTCRay16 ray;
    prepare(ray);
    setOrigin(ray, place);
    setDirection(ray, direction);
    store(ray.tfar, select(look, unlimited, no_distance));
    if (frame.has_see_through)
        return throughPanes(frame, 1.0F, look, ray);
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(look.data(), frame.scene, &context, &ray);
    return select(look & (load(ray.tfar) < 0.0F), 0.0F, 1.0F);
}

/// 0 at the border of the map, 1 from a quarter of the way inward on, so that it ends without a
/// line.
inline Lanes withinMap(const Lanes& column, int row) {
    constexpr float half = 0.5F * ground_map_side;
    const auto inward = [](const Lanes& from_middle) {
        const Lanes s = clamped((Lanes(1.0F) - absolute(from_middle)) * 4.0F);
        return s * s * (Lanes(3.0F) - Lanes(2.0F) * s);
    };
    return inward((column + 0.5F) * (1.0F / half) - 1.0F) *
           inward(Lanes((static_cast<float>(row) + 0.5F) / half - 1.0F));
}

void findOpenGround(const FrameSetup& frame, const GroundDirections& directions, int row,
                    float* open) {
    const FrameGroundMap& map = frame.ground_map;
    const float y = map.corner[1] + (static_cast<float>(row) + 0.5F) / map.texels_a_unit[1];
    for (int first = 0; first < ground_map_side; first += lane_count) {
        const Lanes column = floatsOf(laneNumbers()) + static_cast<float>(first);
        const LaneVectors place{(column + 0.5F) * (1.0F / map.texels_a_unit[0]) + map.corner[0], y,
                                frame.ground_height};
        Lanes arriving = 0.0F;
        for (int i = 0; i < directions.count; ++i)
            arriving = arriving + arrivingOnGround(frame, place, directions.toward[i]);
        const Lanes kept_off =
            Lanes(1.0F) - arriving * (1.0F / static_cast<float>(directions.count));
        const Lanes result = Lanes(1.0F) - kept_off * withinMap(column, row);
        alignas(64) float values[lane_count];
        store(values, result);
        __builtin_memcpy(open + row * ground_map_side + first, values, sizeof values);
    }
}

} // namespace
} // namespace quarn
