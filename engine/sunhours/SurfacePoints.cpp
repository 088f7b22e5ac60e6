#include "engine/sunhours/SurfacePoints.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// How far from the surface rays start, so that rounding never lets them hit the triangle that they
/// leave: by the size of the scene, and by the digits that a place so far away has.
constexpr float LIFT_OF_SIZE = 1e-5F;
constexpr float LIFT_OF_REACH = 2e-6F;

constexpr PointPacket NO_POINTS{};

} // namespace

void SurfacePoints::add(const SurfacePoint& point) {
    resize(m_count + 1);
    set(m_count - 1, point);
}

void SurfacePoints::resize(std::size_t count) {
    m_count = count;
    m_packets.resize((count + points_at_once - 1) / points_at_once, NO_POINTS);
}

void SurfacePoints::set(std::size_t index, const SurfacePoint& point, float distance_of_eye) {
    PointPacket& packet = m_packets[index / points_at_once];
    const std::size_t lane = index % points_at_once;
    float reach = std::abs(distance_of_eye);
    for (int axis = 0; axis < 3; ++axis) {
        packet.place[axis][lane] = point.place[axis];
        packet.face[axis][lane] = point.face[axis];
        reach = std::max(reach, std::abs(point.place[axis]));
    }
    packet.lift[lane] = LIFT_OF_SIZE * m_scene_size + LIFT_OF_REACH * reach;
    packet.back[lane] = point.has_two_sides ? -1.0F : 1.0F;
}

} // namespace quarn
