#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

class DisplayScene;

/// As many points are looked at together.
inline constexpr int points_at_once = 16;

/// Sixteen points of surfaces, in the coordinates of a scene's rays.
struct alignas(64) PointPacket {
    float place[3][points_at_once];
    /// Unit normals of the side that is meant; 0 where there is no point, which the sun never
    /// reaches.
    float face[3][points_at_once];
    float lift[points_at_once]; ///< how far above the surface rays start
    float back[points_at_once]; ///< -1 where the other side is meant too, else 1
};

/// A point of a surface, in the same coordinates.
struct SurfacePoint {
    float place[3];
    float face[3]; ///< of unit length
    bool has_two_sides = false;
};

/// Points of surfaces whose sun is asked for, sixteen in a packet. Those that lie near each other
/// in the list should lie near each other in space too: rays go together.
class SurfacePoints {
public:
    /// @param scene_size  diagonal of the box of all surfaces
    explicit SurfacePoints(double scene_size) : m_scene_size(static_cast<float>(scene_size)) {}

    void add(const SurfacePoint& point);
    /// Makes room for so many points in all; those that are not set are none.
    void resize(std::size_t count);
    /// Sets a point that there is room for. Different packets may be set at once.
    void set(std::size_t index, const SurfacePoint& point, float distance_of_eye = 0.0F);

    std::size_t size() const { return m_count; }
    const std::vector<PointPacket>& packets() const { return m_packets; }

private:
    float m_scene_size;
    std::size_t m_count = 0;
    std::vector<PointPacket> m_packets;
};

} // namespace quarn
