#pragma once

#include <cstdint>
#include <span>
#include <vector>

class KM_Mesh;

namespace quarn {

/// The lines of a mesh, by what they mean to a person. Vertices at the same place count as one, so
/// that a mesh whose faces do not share vertices has the same lines. Edges between triangles that
/// lie in one plane mean nothing and are left out.
class MeshEdges {
public:
    /// Two vertex indices.
    struct Edge {
        std::uint32_t from;
        std::uint32_t to;
    };
    /// An edge where a rounded surface goes on. The packed unit normals are those of the two
    /// triangles, both on the same side of the surface.
    struct SmoothEdge {
        std::uint32_t from;
        std::uint32_t to;
        std::uint32_t normal_a;
        std::uint32_t normal_b;
    };

    /// Triangles whose normals differ by more make a crease, in degrees.
    static constexpr float crease_angle_deg = 25.0F;
    /// Triangles whose normals differ by less lie in one plane.
    static constexpr float flat_angle_deg = 0.5F;

    /// @param mesh  all indices must name vertices
    explicit MeshEdges(const KM_Mesh& mesh);

    /// Borders, creases and edges where more than two triangles meet.
    std::span<const Edge> features() const { return m_features; }
    std::span<const SmoothEdge> smooth() const { return m_smooth; }
    /// Mean length of the smooth edges, in model units; 0 when there are none.
    double meanSmoothLength() const { return m_mean_smooth_length; }

private:
    void classify(const KM_Mesh& mesh, std::span<const struct HalfEdge> alike, std::uint32_t from,
                  std::span<const struct FaceNormal> normals);

    std::vector<Edge> m_features;
    std::vector<SmoothEdge> m_smooth;
    double m_mean_smooth_length = 0.0;
};

} // namespace quarn
