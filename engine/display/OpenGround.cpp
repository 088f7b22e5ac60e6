#include "engine/display/OpenGround.h"

#include "engine/display/AmbientFromAround.h"
#include "engine/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cstring>

namespace quarn {

namespace {

/// How far the map goes beyond the scene's box, in heights of the scene and in widths.
constexpr float BORDER_IN_HEIGHTS = 2.0F;
constexpr float LEAST_BORDER_IN_WIDTHS = 0.15F;
/// Up to this part of the scene's height the ground below surfaces counts.
constexpr float NEAR_IN_HEIGHTS = 0.5F;
constexpr float STEP_IN_TEXELS = 1.5F;

FrameGroundMap mapUnder(const FrameSetup& frame) {
    FrameGroundMap map;
    const float height = frame.scene_max[2] - frame.scene_min[2];
    const float width =
        std::max(frame.scene_max[0] - frame.scene_min[0], frame.scene_max[1] - frame.scene_min[1]);
    const float border = std::max(BORDER_IN_HEIGHTS * height, LEAST_BORDER_IN_WIDTHS * width);
    for (int axis = 0; axis < 2; ++axis) {
        const float side = frame.scene_max[axis] - frame.scene_min[axis] + 2.0F * border;
        map.corner[axis] = frame.scene_min[axis] - border;
        map.texels_a_unit[axis] = ground_map_side / std::max(side, 1e-15F);
    }
    map.step_before = STEP_IN_TEXELS / std::min(map.texels_a_unit[0], map.texels_a_unit[1]);
    map.near_scale = 1.0F / std::max(NEAR_IN_HEIGHTS * height, 1e-15F);
    return map;
}

/// Directions, each for an equal part of the light that arrives at open ground.
GroundDirections directionsOf(const FrameSetup& frame, int wanted) {
    FrameSetup open = frame;
    open.has_ground = false;
    double all = 0.0;
    const auto arrivingFrom = [](float z, const float(&color)[3]) {
        return std::max(z, 0.0F) * (color[0] + color[1] + color[2]);
    };
    lookAround(open, [&](float, float, float z, const float(&color)[3]) {
        all += arrivingFrom(z, color);
    });
    GroundDirections directions{};
    directions.count = wanted;
    double sum = 0.0;
    int count = 0;
    lookAround(open, [&](float x, float y, float z, const float(&color)[3]) {
        sum += arrivingFrom(z, color);
        for (; count < wanted && sum * wanted > (count + 0.5) * all; ++count)
            for (int axis = 0; axis < 3; ++axis)
                directions.toward[count][axis] = axis == 0 ? x : axis == 1 ? y : z;
    });
    // Where there is no light, no shadow is missed.
    for (; count < wanted; ++count)
        directions.toward[count][2] = 1.0F;
    return directions;
}

template <class T> bool areSame(const T& a, const T& b) {
    return std::memcmp(&a, &b, sizeof(T)) == 0;
}

} // namespace

void OpenGround::find(FrameSetup& frame, const RayKernel& kernel, std::uint64_t surfaces_number,
                      int directions_wanted) {
    FrameGroundMap map = mapUnder(frame);
    const GroundDirections directions = directionsOf(frame, directions_wanted);
    const bool is_known = !m_open.empty() && surfaces_number == m_surfaces_number &&
                          areSame(map, m_map) && areSame(directions, m_directions);
    frame.ground_map = map;
    m_open.resize(std::size_t{ground_map_side} * ground_map_side);
    if (!is_known)
        tbb::parallel_for(0, ground_map_side, [&](int row) {
            const FlushDenormals flush;
            kernel.find_open_ground(frame, directions, row, m_open.data());
        });
    m_surfaces_number = surfaces_number;
    m_map = map;
    m_directions = directions;
    frame.ground_map.open = m_open.data();
}

} // namespace quarn
