#pragma once

#include "engine/display/DenseTone.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/LineRaster.h"
#include "engine/display/MeshEdges.h"

#include <span>

namespace quarn {

class VisibleParts;
struct CameraRays;

/// How clearly lines are drawn by their depth: far ones are lighter, so that near ones stand out.
class DepthFade {
public:
    /// No fading: every line has this strength.
    explicit DepthFade(float strength = 1.0F) : m_strength(strength) {}
    /// @param far_strength  of the farthest lines of the box, beside the nearest
    /// @param box           in the coordinates of the frame
    DepthFade(float strength, float far_strength, const CameraRays& rays,
              const KM_BoundingBox& box);

    /// @param nearness  in the measure of DepthImage
    float at(float nearness) const;

private:
    float m_strength;
    float m_loss = 0.0F;
    float m_near = 0.0F;
    float m_depth_range = 1.0F;
    float m_far_depth = 0.0F; ///< of a parallel view
    bool m_parallel = false;
};

/// Projects the edges of one mesh object onto the picture.
class MeshLines {
public:
    /// @param visible_parts  cuts out of the edges what is seen; null: they are kept whole
    MeshLines(const DisplayScene::MeshObject& object, const CameraRays& rays,
              const ScreenProjection& projection, const DepthFade& fade,
              VisibleParts* visible_parts = nullptr);

    /// All of the edges, as clearly as they can be told apart.
    void addAll(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const;
    void addAll(std::span<const MeshEdges::FlatEdge> edges, LineBatch& batch) const;
    /// Those where the surface turns away from the observer, or ends.
    void addOutlines(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const;
    /// The others.
    void addInner(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const;

private:
    bool isOutline(const MeshEdges::Edge& edge) const;
    void add(std::uint32_t from, std::uint32_t to, LineBatch& batch) const;
    void addDense(std::uint32_t from, std::uint32_t to, LineBatch& batch) const;
    void addVisible(const ScreenSegment& segment, LineBatch& batch) const;
    bool project(std::uint32_t from, std::uint32_t to, ScreenSegment& segment) const;

    std::span<const KM_3fPoint> m_vertices;
    const KM_Xform& m_frame_from_mesh;
    bool m_stands; ///< the mesh is in the frame's coordinates already
    bool m_parallel;
    KM_3dPoint m_eye;       ///< in the coordinates of the mesh, as are the normals of its edges
    KM_3dVector m_backward; ///< against the direction of view
    const ScreenProjection& m_projection;
    const DepthFade& m_fade;
    VisibleParts* m_visible_parts;
    EdgeSpacing m_spacing;
};

} // namespace quarn
