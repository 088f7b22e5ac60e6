#pragma once

#include <cstdint>
#include <span>
#include <vector>

class KM_Mesh;

namespace quarn {

/// The lines of a mesh, by what they mean to a person. Vertices at the same place count as one, so
/// that a mesh whose faces do not share vertices has the same lines.
class MeshEdges {
public:
    /// Two vertex indices, and the packed unit normals of the two triangles that meet, both on the
    /// same side of the surface. Where there is no second triangle, or more than two, the second
    /// normal is the opposite of the first: such an edge is an outline from wherever it is seen.
    struct Edge {
        std::uint32_t from;
        std::uint32_t to;
        std::uint32_t normal_a;
        std::uint32_t normal_b;
    };
    /// Two vertex indices.
    struct FlatEdge {
        std::uint32_t from;
        std::uint32_t to;
    };

    /// Triangles whose normals differ by more make a crease, in degrees: where the mesh has vertex
    /// normals that break there, where it has none, and where they run on smoothly.
    static constexpr float broken_crease_deg = 18.0F;
    static constexpr float crease_angle_deg = 25.0F;
    static constexpr float smooth_crease_deg = 60.0F;
    /// Triangles whose normals differ by less lie in one plane.
    static constexpr float flat_angle_deg = 0.5F;
    /// Creases that hang together without a border or a closed loop, and are shorter than this part
    /// of the mesh's size, are accidents of its triangles: they count as smooth.
    static constexpr double shortest_crease = 0.25;

    /// @param mesh  all indices must name vertices
    explicit MeshEdges(const KM_Mesh& mesh);

    /// Borders, creases and edges where more than two triangles meet.
    std::span<const Edge> features() const { return m_features; }
    /// Edges where a rounded surface goes on.
    std::span<const Edge> smooth() const { return m_smooth; }
    /// Edges between triangles that lie in one plane: they mean nothing but how the mesh is made.
    std::span<const FlatEdge> flat() const { return m_flat; }
    /// Mean length of the edges that are no features, in model units; 0 when there are none.
    double meanInnerLength() const { return m_mean_inner_length; }

private:
    void classify(const class EdgeFinder& finder, std::span<const struct HalfEdge> alike,
                  std::uint32_t from);
    void dropAccidentalCreases(const KM_Mesh& mesh);
    void measureInner(const KM_Mesh& mesh);

    std::vector<Edge> m_features;
    std::vector<Edge> m_smooth;
    std::vector<FlatEdge> m_flat;
    double m_mean_inner_length = 0.0;
};

} // namespace quarn
